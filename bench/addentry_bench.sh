#!/usr/bin/env bash
# Times `quillmark-cli add-entry` of a two-person census entry (load, backup,
# rewrite, safely on disk) against one durable copy of the same file
# (dd ... conv=fsync), both with the file in the page cache.
#
# usage: bench/addentry_bench.sh CLI [FAMILY.ged] [RUNS]
#   CLI        path of quillmark-cli
#   FAMILY.ged a generated family file (default fam1000000.ged in QM_BENCH_DIR,
#              else in build/gen of the repository); it
#              is copied first and never changed
# The work folder is made under ${TMPDIR:-/tmp} and removed at the end.
set -euo pipefail
cli=$(realpath "$1")
here=$(cd "$(dirname "$0")/.." && pwd)
src=${2:-${QM_BENCH_DIR:-$here/build/gen}/fam1000000.ged}
runs=${3:-3}
work=$(mktemp -d "${TMPDIR:-/tmp}/addentry_bench.XXXXXX")
trap 'rm -rf "$work"' EXIT

# Backups and the census log go to the program folder under XDG_DATA_HOME; an
# empty settings file gives every setting its default ("Full Entry" on, "Keep
# Log" on, UK censuses; backups in the program folder's Backups).
export XDG_DATA_HOME="$work/data"
: > "$work/settings.ini"
cat > "$work/entry.json" <<'JSON'
{"year": 1881, "place": "Leeds, Yorkshire, England", "address": "4 Park Row", "reference": "RG11/4521/17",
 "other": "Benchmark household", "source_text": "Head 40\nWife 38",
 "individuals": [{"id": 1, "age": "40", "occupation": "Weaver"}, {"id": 2, "age": "38", "birthplace": "Leeds"}]}
JSON
cp "$src" "$work/family.ged"
cat "$work/family.ged" > /dev/null

now() { date +%s.%N; }
ddtimes=() clitimes=() cputimes=()
for ((i = 0; i < runs; i++)); do
    cat "$work/family.ged" > /dev/null
    t0=$(now); dd if="$work/family.ged" of="$work/copy.ged" bs=1M conv=fsync status=none; t1=$(now)
    ddtimes+=("$(echo "$t1 - $t0" | bc)")
    rm -f "$work/copy.ged"
    cat "$work/family.ged" > /dev/null
    t0=$(now)
    /usr/bin/time -o "$work/cpu" -f '%U %S' \
        "$cli" add-entry "$work/family.ged" --entry "$work/entry.json" --settings "$work/settings.ini" > "$work/out.json"
    t1=$(now)
    clitimes+=("$(echo "$t1 - $t0" | bc)")
    cputimes+=("$(awk '{print $1 + $2}' "$work/cpu")")
    rm -f "$work/data/Quillmark/Backups/QM Backup"*
done

median() { printf '%s\n' "$@" | sort -n | awk '{a[NR]=$1} END {print a[int((NR+1)/2)]}'; }
dd_m=$(median "${ddtimes[@]}")
cli_m=$(median "${clitimes[@]}")
echo "file:            $src ($(stat -c %s "$src") bytes)"
echo "dd conv=fsync:   ${ddtimes[*]} s (median $dd_m s)"
echo "add-entry:       ${clitimes[*]} s (median $cli_m s)"
echo "add-entry CPU:   ${cputimes[*]} s (user + system; the wall time above includes waiting for the disk and for other processes)"
echo "load average:    $(cut -d' ' -f1-3 /proc/loadavg)"
echo "ratio:           $(echo "scale=2; $cli_m / $dd_m" | bc) (limit 4)"
