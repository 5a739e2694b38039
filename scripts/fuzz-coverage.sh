#!/usr/bin/env bash
# Source coverage of the library reached by the fuzzers' corpora: builds the
# fuzz targets with coverage (preset `coverage`), replays each target's seed
# corpus and any further corpus folders given, and prints llvm-cov's report
# for src/.
#   scripts/fuzz-coverage.sh [EXTRA_CORPUS_ROOT]
# EXTRA_CORPUS_ROOT holds one folder per target (e.g. a long run's corpora).
# Needs Debian's llvm-14 (llvm-profdata-14, llvm-cov-14), which the tests do
# not install.
set -euo pipefail
cd "$(dirname "$0")/.."
extra=${1:-}
cmake --preset coverage >/dev/null
cmake --build --preset coverage -j "$(nproc)" >/dev/null
out=build/coverage/profiles
rm -rf "$out" && mkdir -p "$out"
binaries=()
for fuzzer in build/coverage/fuzz/*_fuzz; do
  name=$(basename "$fuzzer")
  corpora=(fuzz/corpus/"$name")
  [ -n "$extra" ] && [ -d "$extra/$name" ] && corpora+=("$extra/$name")
  echo "replaying $name: ${corpora[*]}" >&2
  LLVM_PROFILE_FILE="$out/$name.profraw" \
    LSAN_OPTIONS=suppressions=$PWD/fuzz/lsan.supp "$fuzzer" -runs=0 "${corpora[@]}" >/dev/null 2>&1
  binaries+=("$fuzzer")
done
llvm-profdata-14 merge -sparse "$out"/*.profraw -o "$out/all.profdata"
others=()
for binary in "${binaries[@]:1}"; do others+=(-object "$binary"); done
llvm-cov-14 report -instr-profile="$out/all.profdata" "${binaries[0]}" "${others[@]}" \
  -ignore-filename-regex='/(standin|fuzz|tests|usr)/|_res\.cpp$'
