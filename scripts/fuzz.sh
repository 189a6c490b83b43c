#!/usr/bin/env bash
# Builds the libFuzzer targets (fuzz/) with clang in <build folder>-fuzz and
# runs each for a fixed number of inputs over its seeds, so that they cannot
# rot: the loader over the bundled examples and ../shared/corpus (when
# present), the date recogniser and the entry file over fuzz/seeds/<target>.
# A fixed number of inputs each (the loader 3000, its inputs being whole
# family files; the dates and entry targets 30000), or QM_FUZZ_RUNS for all;
# the same seed every time, so a failure can be run again. New inputs go to a temporary folder, never into
# the seed folders.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
build="${QM_BUILD_DIR:-$here/build}-fuzz"
launcher=()
command -v ccache >/dev/null && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
targets=(loadgedcom dates entry)

cmake -S "$here" -B "$build" -G Ninja -DCMAKE_CXX_COMPILER=clang++ -DQM_FUZZ=ON -DQM_TESTS=OFF -DQM_BENCH=OFF \
      -DCMAKE_BUILD_TYPE=RelWithDebInfo "${launcher[@]}" >/dev/null
cmake --build "$build" --target "${targets[@]/%/_fuzz}"

work="$(mktemp -d)"
trap 'rm -rf "$work"' EXIT
for t in "${targets[@]}"; do
  seeds=()
  if [ "$t" = loadgedcom ]; then
    seeds+=("$here/examples")
    [ -d "$here/../shared/corpus" ] && seeds+=("$here/../shared/corpus")
  else
    seeds+=("$here/fuzz/seeds/$t")
  fi
  runs=${QM_FUZZ_RUNS:-$([ "$t" = loadgedcom ] && echo 3000 || echo 30000)}
  mkdir -p "$work/$t"
  start=$SECONDS
  if ! "$build/fuzz/${t}_fuzz" -runs="$runs" -seed=1 -max_len=200000 -timeout=30 -rss_limit_mb=2048 \
       -artifact_prefix="$build/${t}_fuzz-" "$work/$t" "${seeds[@]}" >"$work/$t.log" 2>&1; then
    tail -n 60 "$work/$t.log"
    echo "fuzz: ${t}_fuzz failed (log above; the input that failed is saved as $build/${t}_fuzz-crash-*)"
    exit 1
  fi
  echo "fuzz: ${t}_fuzz ran $runs inputs after its seeds in $((SECONDS - start)) s: $(grep -o 'cov: [0-9]*' "$work/$t.log" | tail -n 1)"
done
