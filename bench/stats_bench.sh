#!/usr/bin/env bash
# Times `quillmark-cli stats` (the load of a family file) against `wc -l` on
# the same file, both with the file in the page cache, and reports the
# tool's peak memory against the file's size.
#
# usage: bench/stats_bench.sh CLI [FAMILY.ged] [RUNS]
#   CLI        path of quillmark-cli
#   FAMILY.ged a generated family file (default fam1000000.ged in QM_BENCH_DIR,
#              else in build/gen of the repository); it
#              is only read
set -euo pipefail
cli=$(realpath "$1")
here=$(cd "$(dirname "$0")/.." && pwd)
src=${2:-${QM_BENCH_DIR:-$here/build/gen}/fam1000000.ged}
runs=${3:-5}
work=$(mktemp -d "${TMPDIR:-/tmp}/stats_bench.XXXXXX")
trap 'rm -rf "$work"' EXIT
# An empty settings file: no flag definitions of the user's are read.
: > "$work/settings.ini"
cat "$src" > /dev/null

wctimes=() clitimes=() rss=()
for ((i = 0; i < runs; i++)); do
    /usr/bin/time -o "$work/wc" -f '%e' wc -l "$src" > /dev/null
    wctimes+=("$(cat "$work/wc")")
    /usr/bin/time -o "$work/cli" -f '%e %M' "$cli" stats "$src" --settings "$work/settings.ini" > /dev/null
    clitimes+=("$(cut -d' ' -f1 "$work/cli")")
    rss+=("$(cut -d' ' -f2 "$work/cli")")
done

median() { printf '%s\n' "$@" | sort -n | awk '{a[NR]=$1} END {print a[int((NR+1)/2)]}'; }
wc_m=$(median "${wctimes[@]}")
cli_m=$(median "${clitimes[@]}")
rss_m=$(median "${rss[@]}")
size=$(stat -c %s "$src")
echo "file:            $src ($size bytes)"
echo "wc -l:           ${wctimes[*]} s (median $wc_m s)"
echo "stats:           ${clitimes[*]} s (median $cli_m s)"
echo "peak memory:     ${rss[*]} KiB (median $rss_m KiB, $(echo "scale=2; $rss_m * 1024 / $size" | bc) of the file's size; limit 1)"
echo "load average:    $(cut -d' ' -f1-3 /proc/loadavg)"
echo "ratio:           $(echo "scale=2; $cli_m / $wc_m" | bc) (limit 6)"
