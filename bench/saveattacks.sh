#!/usr/bin/env bash
# Attacks on the save road, run against quillmark-cli add-entry with generated
# family files, as a hostile tester would: what must hold is printed as a count
# of rounds that held, and the script exits non-zero when one did not.
#
# usage: bench/saveattacks.sh CLI ATTACK [ROUNDS]
#   pairs     two add-entry runs started together, on two family files with
#             one backup folder, and on one family file (fam10000.ged)
#   appends   another program appends to the family file at evenly spread
#             moments of the whole save (fam300000.ged)
#   identity  group, ACL, extended attribute and hard link kept (fam10000.ged)
#   kill9     add-entry killed (SIGKILL) at random moments (fam300000.ged):
#             the family file is always the old one or the new one, whole
#             (QM_KILL_FROM=0.8 kills only in the last fifth of a save, around
#             the replace)
# Generated files are read from ${QM_GEN:-/work/gen} and copied; the work
# folder is made under ${TMPDIR:-/tmp} and removed at the end.
set -euo pipefail
cli=$(realpath "$1")
attack=$2
gen=${QM_GEN:-/work/gen}
work=$(mktemp -d "${TMPDIR:-/tmp}/saveattacks.XXXXXX")
trap 'rm -rf "$work"' EXIT
export XDG_DATA_HOME="$work/data" XDG_CONFIG_HOME="$work/config"
mkdir -p "$work/backups"

# Every setting at its default except where backups and the log go.
settings() {
    cat > "$work/settings.ini" <<INI
[General]
Full%20Entry=1
Source%20in%20Note=0
Keep%20Log=1
Log%20Path=$work/censuslog.txt
Country=UK
Birthdate=1
Certainty=-1
Residence=0
Source%20Type=Census
Request%20Image=0
ID%20Only=0
Auto%20Reference=0
Backup%20Folder=$work/backups
Flag%20Use=0
Flag%20Check=0
Opt1%20Entry%20Date=0
Opt1%20Where%20in%20Source=0
Opt1%20Publication%20Info=0
Request%20Images%202=0
Image%202%20Event=0
Entry%20Date%20Today=0
Occ%20Place=1
Occ%20Age=0
Shared%20Note=0
Title="Census {YEAR} {PLACE} {REF} ({OTHER})"
ASID=1
File%20Open%20Default=1
Source%20Note=0
Occ%20Scholar=1
Birth%20Secondary%20Evidence=0
Alternate%20Separator=0
Alternate%20Separator%20Character=-
Marriage%20Condition=0
No%20Source%20Text%20Warning=1
INI
}
settings
# Individuals 1 and 2 are in every generated file.
cat > "$work/entry.json" <<'JSON'
{"year": 1881, "place": "Leeds, Yorkshire, England", "address": "4 Park Row", "reference": "RG11/4521/17",
 "other": "Attack household", "source_text": "Head 40\nWife 38",
 "individuals": [{"id": 1, "age": "40", "occupation": "Weaver"}, {"id": 2, "age": "38"}]}
JSON
addentry() { "$cli" add-entry "$1" --entry "$work/entry.json" --settings "$work/settings.ini"; }
now() { date +%s.%N; }
failed=0
fail() { echo "FAILED: $*"; failed=1; }

case $attack in
pairs)
    rounds=${3:-20}
    cp "$gen/fam10000.ged" "$work/original.ged"
    held=0
    for ((i = 0; i < rounds; i++)); do
        cp "$work/original.ged" "$work/a.ged"; cp "$work/original.ged" "$work/b.ged"
        addentry "$work/a.ged" > "$work/a.out" 2> "$work/a.err" & pa=$!
        addentry "$work/b.ged" > "$work/b.out" 2> "$work/b.err" & pb=$!
        sa=0 sb=0; wait $pa || sa=$?; wait $pb || sb=$?
        ok=1
        for x in a b; do
            backup=$(python3 -c 'import json,sys; print(json.load(open(sys.argv[1]))["backup"])' "$work/$x.out" 2>/dev/null || true)
            if [ -z "$backup" ] || ! cmp -s "$backup" "$work/original.ged"; then ok=0; fail "pair $i: $x printed backup '$backup' that does not hold its file ($(cat "$work/$x.err"))"; fi
        done
        [ "$sa" = 0 ] && [ "$sb" = 0 ] || { ok=0; fail "pair $i: exit $sa $sb"; }
        n=$(ls "$work/backups" | wc -l)
        [ "$n" = $((2 * (i + 1))) ] || { ok=0; fail "pair $i: $n backups in the folder"; }
        held=$((held + ok))
    done
    echo "two files, one backup folder: $held of $rounds pairs held (both saved, both backups there and whole; $(ls "$work/backups" | wc -l) backups)"

    held=0 refusals=()
    rm -f "$work/backups/"*
    for ((i = 0; i < rounds; i++)); do
        cp "$work/original.ged" "$work/one.ged"
        addentry "$work/one.ged" > "$work/a.out" 2> "$work/a.err" & pa=$!
        addentry "$work/one.ged" > "$work/b.out" 2> "$work/b.err" & pb=$!
        sa=0 sb=0; wait $pa || sa=$?; wait $pb || sb=$?
        sources=$(grep -ac '^0 @S.*@ SOUR' "$work/one.ged")
        want=$(( $(grep -ac '^0 @S.*@ SOUR' "$work/original.ged") + 1 ))
        backups=$(ls "$work/backups" | wc -l)
        if [ $((sa + sb)) = 2 ] && [ "$sources" = "$want" ] && [ "$backups" = 1 ] && tail -c 8 "$work/one.ged" | grep -q TRLR; then
            held=$((held + 1))
            refusals+=("$(cat "$work/a.err" "$work/b.err" | sed -e 's/ (process.*//' -e 's/^quillmark-cli: //' | cut -c1-60)")
        else
            fail "same file, pair $i: exit $sa $sb, $sources sources (want $want), $backups backups: $(cat "$work/a.err" "$work/b.err")"
        fi
        rm -f "$work/backups/"*
    done
    echo "one file, two saves at once: $held of $rounds pairs held (one saved, one refused, one new source, one backup)"
    printf '%s\n' "${refusals[@]}" | sort | uniq -c | sed 's/^/    refused: /'
    ;;

appends)
    rounds=${3:-20}
    src="$gen/fam300000.ged"
    cp "$src" "$work/original.ged"
    cp "$work/original.ged" "$work/family.ged"; cat "$work/family.ged" > /dev/null
    t0=$(now); addentry "$work/family.ged" > /dev/null; t1=$(now)
    whole=$(echo "$t1 - $t0" | bc)
    rm -f "$work/backups/"*
    echo "add-entry on $(basename "$src") alone: $whole s; appends at $rounds moments spread over it"
    kept=0 saved=0 refused=0
    for ((i = 0; i < rounds; i++)); do
        cp "$work/original.ged" "$work/family.ged"; cat "$work/family.ged" > /dev/null
        at=$(echo "scale=3; $whole * ($i + 0.5) / $rounds" | bc)
        marker="0 @N99999@ NOTE appended by another program in round $i"
        addentry "$work/family.ged" > "$work/out" 2> "$work/err" & p=$!
        sleep "$at"; printf '%s\r\n' "$marker" >> "$work/family.ged"; t=$(now)
        s=0; wait $p || s=$?
        if grep -aqF "$marker" "$work/family.ged"; then kept=$((kept + 1)); else fail "round $i (append at $at s): the append is lost (exit $s: $(cat "$work/err"))"; fi
        if [ "$s" = 0 ]; then saved=$((saved + 1)); else
            refused=$((refused + 1))
            grep -q "modified by another application" "$work/err" || fail "round $i: exit $s: $(cat "$work/err")"
            cmp -s <(head -c "$(stat -c %s "$work/original.ged")" "$work/family.ged") "$work/original.ged" || fail "round $i: refused, but the file changed"
        fi
        echo "  round $i: append at $at s: $([ "$s" = 0 ] && echo "saved, append after the replace, kept" || echo "refused (outside change), append kept")"
        rm -f "$work/backups/"*
    done
    echo "appends kept: $kept of $rounds ($saved saves after which the append landed in the new file, $refused saves refused)"
    ;;

identity)
    cp "$gen/fam10000.ged" "$work/original.ged"
    check() { # name, command that sets it up, python expression on the file that must stay true
        local name=$1 set=$2
        rm -f "$work/f.ged" "$work/f-other-name.ged"
        cp "$work/original.ged" "$work/f.ged"
        if ! eval "$set" 2>/dev/null; then echo "$name: cannot be set here, skipped"; return; fi
        local before after
        before=$(python3 "$work/identity.py" "$work/f.ged")
        addentry "$work/f.ged" > /dev/null 2> "$work/err" || { fail "$name: add-entry: $(cat "$work/err")"; return; }
        after=$(python3 "$work/identity.py" "$work/f.ged")
        if [ "$before" = "$after" ] && ! cmp -s "$work/f.ged" "$work/original.ged"; then
            echo "$name: kept ($after)"
        else
            fail "$name: before [$before] after [$after]"
        fi
    }
    cat > "$work/identity.py" <<'PY'
import os, sys, stat
p = sys.argv[1]
st = os.stat(p)
x = {n: os.getxattr(p, n).hex() for n in sorted(os.listxattr(p))}
print(f"owner {st.st_uid}:{st.st_gid} mode {stat.S_IMODE(st.st_mode):o} links {st.st_nlink} xattrs {x}")
PY
    check "group (660 root:4242)" 'chown :4242 "$work/f.ged" && chmod 660 "$work/f.ged"'
    check "ACL (u:nobody:rw)" 'setfacl -m u:65534:rw "$work/f.ged"'
    check "extended attribute" 'python3 -c "import os,sys; os.setxattr(sys.argv[1], \"user.origin\", b\"scanned 1881\")" "$work/f.ged"'
    check "hard link" 'ln "$work/f.ged" "$work/f-other-name.ged"'
    if [ -f "$work/f-other-name.ged" ]; then
        cmp -s "$work/f.ged" "$work/f-other-name.ged" && echo "hard link: the other name sees the new content" || fail "hard link: the other name differs"
    fi
    # A file shared through a group (660 root:4242), saved by another member of
    # the group, who cannot give a new file root as its owner.
    if [ "$(id -u)" = 0 ] && command -v setpriv > /dev/null; then
        chmod 777 "$work" "$work/backups"; touch "$work/censuslog.txt"; chmod 666 "$work/censuslog.txt"
        chmod 755 "$cli"
        addentry() { setpriv --reuid=65534 --regid=65534 --groups=4242 "$cli" add-entry "$1" --entry "$work/entry.json" --settings "$work/settings.ini"; }
        check "group member's save of 660 root:4242" 'chown root:4242 "$work/f.ged" && chmod 660 "$work/f.ged"'
    fi
    ;;

kill9)
    rounds=${3:-50}
    src="$gen/fam300000.ged"
    cp "$src" "$work/family.ged"; cat "$work/family.ged" > /dev/null
    t0=$(now); addentry "$work/family.ged" > /dev/null; t1=$(now)
    whole=$(echo "$t1 - $t0" | bc)
    echo "add-entry on $(basename "$src") alone: $whole s; SIGKILL at random moments within it"
    cp "$work/family.ged" "$work/prev.ged"
    untouched=0 replaced=0 mixed=0
    for ((i = 0; i < rounds; i++)); do
        rm -f "$work/backups/"*
        sources=$(grep -ac '^0 @S.*@ SOUR' "$work/prev.ged")
        at=$(python3 -c "import random; print(round(random.uniform($whole * ${QM_KILL_FROM:-0}, $whole * 1.05), 3))")
        # The tool itself in the background (not a function's subshell), so that the kill reaches it.
        "$cli" add-entry "$work/family.ged" --entry "$work/entry.json" --settings "$work/settings.ini" > /dev/null 2> "$work/err" & p=$!
        sleep "$at"; kill -9 $p 2>/dev/null || true; wait $p 2>/dev/null || true
        if grep -q "Another Quillmark" "$work/err"; then fail "round $i: the lock of the killed save was not taken over"; fi
        if cmp -s "$work/family.ged" "$work/prev.ged"; then
            untouched=$((untouched + 1)); state=untouched
        elif [ "$(grep -ac '^0 @S.*@ SOUR' "$work/family.ged")" = $((sources + 1)) ] && tail -c 8 "$work/family.ged" | grep -q '0 TRLR' \
             && cmp -s <(grep -av -e '^0 @S.*@ SOUR' -e '^[123] ' "$work/prev.ged") <(grep -av -e '^0 @S.*@ SOUR' -e '^[123] ' "$work/family.ged"); then
            replaced=$((replaced + 1)); state=replaced
            cp "$work/family.ged" "$work/prev.ged"
        else
            mixed=$((mixed + 1)); state=MIXED
            fail "round $i (kill at $at s): the family file is neither the old one nor a whole new one"
            cp "$work/family.ged" "$work/prev.ged"
        fi
        # What a killed save leaves: its lock (taken over by the next save) and its temporary file.
        temps=$(ls -A "$work" | grep -c '^\..*\.quillmark-' || true)
        locks=$(ls -A "$work" | grep -c 'quillmark-lock$' || true)
        echo "  kill $i at $at s: $state; left beside it: $temps temporary file(s), $locks lock(s)"
        rm -f "$work"/.family.ged.quillmark-[0-9a-z]*
    done
    echo "kill -9: $rounds kills: $untouched left the file as it was, $replaced after the replace, $mixed mixed"
    ;;
*)
    echo "unknown attack $attack" >&2; exit 2 ;;
esac
exit $failed
