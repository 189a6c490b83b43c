# The rule of the source tree, checked by ctest (entry "layering"):
#   cmake -DQM_SRC=<src> -DQM_QTCORE_INCLUDE=<Qt Core include dirs, "|"-separated>
#         -DQM_CORE_LINKS=<what quillmark_core links, "|"-separated> -P checklayers.cmake
#
# 1. Dependencies run one way. Each source file sits on a layer; a file may
#    include a file of its own folder, or one on a lower layer. The layers,
#    from the top:
#      7 app/                     builds the window, wires the features, starts the program
#      6 images/ log/ settings/ tools/ (their windows and tools; never each other)
#      5 flags/                   (the date check allocates flags)
#      4 census/                  (its table and lists serve the flags, tools and options)
#      3 writer/                  the open file, the save road, the rewrite
#      2 log/censuslog, settings/settings, writer/censusentry.h
#                                 the census log, the settings and an entry's data,
#                                 which the writer uses
#      1 model/, flags/flagtable  the index (which holds the flag definitions)
#    On layers 1 and 2, files placed there from other folders may include one
#    another.
#      0 platform/
#    So nothing outside app/ includes app/.
# 2. quillmark_core (every file that is not a window: not *frm.*, not *_ui.*,
#    not app/main.cpp or app/cli*) includes no QtGui or QtWidgets header and
#    no window header, and links nothing but Qt Core.

cmake_minimum_required(VERSION 3.22)

set(layer_platform 0)
set(layer_model 1)
set(layer_writer 3)
set(layer_census 4)
set(layer_flags 5)
set(layer_images 6)
set(layer_log 6)
set(layer_settings 6)
set(layer_tools 6)
set(layer_app 7)

# The layer of a file, by its path under src/ ("flags/flagtable.h").
function(qm_layer path out)
  if(path MATCHES "^flags/flagtable\\.")
    set(${out} 1 PARENT_SCOPE)
  elseif(path MATCHES "^(log/censuslog|settings/settings)\\.(h|cpp)$" OR path STREQUAL "writer/censusentry.h")
    set(${out} 2 PARENT_SCOPE)
  else()
    string(REGEX REPLACE "/.*" "" folder "${path}")
    if(DEFINED layer_${folder})
      set(${out} ${layer_${folder}} PARENT_SCOPE)
    else()
      set(${out} -1 PARENT_SCOPE)
    endif()
  endif()
endfunction()

function(qm_iscore path out)
  if(path MATCHES "(frm|_ui)\\.(cpp|h)$" OR path STREQUAL "app/main.cpp" OR path MATCHES "^app/cli")
    set(${out} FALSE PARENT_SCOPE)
  else()
    set(${out} TRUE PARENT_SCOPE)
  endif()
endfunction()

set(faults)
string(REPLACE "|" ";" qtcore_dirs "${QM_QTCORE_INCLUDE}")
set(qtcore)
foreach(d IN LISTS qtcore_dirs)
  if(d MATCHES "/QtCore/?$")
    set(qtcore "${d}")
  endif()
endforeach()
if(NOT qtcore)
  message(FATAL_ERROR "checklayers: no QtCore include folder among '${QM_QTCORE_INCLUDE}'")
endif()

file(GLOB_RECURSE files RELATIVE "${QM_SRC}" "${QM_SRC}/*.h" "${QM_SRC}/*.cpp")
foreach(f IN LISTS files)
  qm_layer("${f}" from)
  if(from LESS 0)
    list(APPEND faults "${f}: a folder the rule does not know (add it to cmake/checklayers.cmake)")
    continue()
  endif()
  string(REGEX REPLACE "/.*" "" fromfolder "${f}")
  qm_iscore("${f}" core)
  file(STRINGS "${QM_SRC}/${f}" lines REGEX "^[ \t]*#[ \t]*include[ \t]*[<\"]")
  foreach(line IN LISTS lines)
    if(line MATCHES "#[ \t]*include[ \t]*\"([^\"]+)\"")
      set(to "${CMAKE_MATCH_1}")
      if(NOT to MATCHES "/" OR NOT EXISTS "${QM_SRC}/${to}")
        continue() # beside the file, or generated (moc, rcc)
      endif()
      string(REGEX REPLACE "/.*" "" tofolder "${to}")
      qm_layer("${to}" layer)
      if(tofolder STREQUAL "app" AND NOT fromfolder STREQUAL "app")
        list(APPEND faults "${f}: includes ${to}: nothing outside src/app/ includes src/app/")
      elseif(NOT tofolder STREQUAL fromfolder AND NOT layer LESS from AND NOT (layer EQUAL from AND layer LESS 3))
        list(APPEND faults "${f}: includes ${to}, which sits on a layer not below its own (${from} -> ${layer})")
      endif()
      qm_iscore("${to}" tocore)
      if(core AND NOT tocore)
        list(APPEND faults "${f}: a file of quillmark_core includes the window header ${to}")
      endif()
    elseif(core AND line MATCHES "#[ \t]*include[ \t]*<(Q[^>]*)>")
      set(h "${CMAKE_MATCH_1}")
      if(h MATCHES "^Qt(Gui|Widgets)/" OR (NOT h MATCHES "/" AND NOT EXISTS "${qtcore}/${h}"))
        list(APPEND faults "${f}: a file of quillmark_core includes <${h}>, which is not Qt Core")
      endif()
    endif()
  endforeach()
endforeach()

string(REPLACE "|" ";" links "${QM_CORE_LINKS}")
foreach(l IN LISTS links)
  if(NOT l STREQUAL "Qt6::Core")
    list(APPEND faults "quillmark_core links ${l}: it links Qt Core only")
  endif()
endforeach()

list(LENGTH files count)
if(faults)
  list(JOIN faults "\n  " text)
  message(FATAL_ERROR "The source tree breaks its layering:\n  ${text}")
endif()
message(STATUS "${count} source files keep to their layers; quillmark_core is Qt Core only")
