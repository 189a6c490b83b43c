#!/usr/bin/env bash
# Times `quillmark-cli coverage` (load, every cell, the JSON of every
# individual) against `quillmark-cli stats` (the load alone) on the same file,
# run after run, both with the file in the page cache; reports the medians,
# their ratio (target: at most 2.5) and the peak memory of both.
#
# usage: bench/coverage_bench.sh CLI [FAMILY.ged] [RUNS] [coverage options...]
#   CLI        path of quillmark-cli
#   FAMILY.ged a generated family file (default fam1000000.ged in QM_BENCH_DIR,
#              else in build/gen of the repository); it is only read
#   options    given to coverage, e.g. --format csv or --country USA
set -euo pipefail
cli=$(realpath "$1")
here=$(cd "$(dirname "$0")/.." && pwd)
src=${2:-${QM_BENCH_DIR:-$here/build/gen}/fam1000000.ged}
runs=${3:-5}
shift $(( $# < 3 ? $# : 3 ))
work=$(mktemp -d "${TMPDIR:-/tmp}/coverage_bench.XXXXXX")
trap 'rm -rf "$work"' EXIT
# An empty settings file: every setting takes its default (UK, Residence off).
: > "$work/settings.ini"
cat "$src" > /dev/null

statstimes=() covtimes=() statsrss=() covrss=()
for ((i = 0; i < runs; i++)); do
    /usr/bin/time -o "$work/stats" -f '%e %M' "$cli" stats "$src" --settings "$work/settings.ini" > /dev/null 2>&1
    statstimes+=("$(cut -d' ' -f1 "$work/stats")")
    statsrss+=("$(cut -d' ' -f2 "$work/stats")")
    /usr/bin/time -o "$work/cov" -f '%e %M' "$cli" coverage "$src" --settings "$work/settings.ini" "$@" \
        > "$work/out" 2> /dev/null
    covtimes+=("$(cut -d' ' -f1 "$work/cov")")
    covrss+=("$(cut -d' ' -f2 "$work/cov")")
    bytes=$(stat -c %s "$work/out")
    rm -f "$work/out"
done

median() { printf '%s\n' "$@" | sort -n | awk '{a[NR]=$1} END {print a[int((NR+1)/2)]}'; }
stats_m=$(median "${statstimes[@]}")
cov_m=$(median "${covtimes[@]}")
echo "file:            $src ($(stat -c %s "$src") bytes)"
echo "stats:           ${statstimes[*]} s (median $stats_m s), peak memory median $(median "${statsrss[@]}") KiB"
echo "coverage $*:  ${covtimes[*]} s (median $cov_m s), peak memory median $(median "${covrss[@]}") KiB, output $bytes bytes"
echo "load average:    $(cut -d' ' -f1-3 /proc/loadavg)"
echo "ratio:           $(echo "scale=2; $cov_m / $stats_m" | bc) (limit 2.5)"
