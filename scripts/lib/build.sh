# SPDX-License-Identifier: MIT
# Functions for the scripts beside this folder. The sourcing script has `set -euo pipefail`.

tree=$(cd "$(dirname "${BASH_SOURCE[0]}")/../.." && pwd)
jobs=$(nproc 2>/dev/null || echo 2)
run_with=()
cd "$tree"
mkdir -p build/logs

fail() {
  echo "scripts/$(basename "$0"): $*" >&2
  exit 1
}

# quietly LOG COMMAND...: says nothing, but shows the end of what was said when it fails.
quietly() {
  local log=$1
  shift
  if ! "$@" >"$log" 2>&1 </dev/null; then
    # What went wrong stands at the first error; the rest follows from it.
    grep -n -m 5 -A 12 -E '(^|[^_])(error|FAILED|CMake Error)' "$log" >&2 || tail -n 30 "$log" >&2
    return 1
  fi
}

# configure PRESET [ARGUMENT...]
configure() {
  local preset=$1
  shift
  quietly "build/logs/$preset-configure.log" cmake --preset "$preset" "$@" ||
    fail "the $preset preset could not be configured; see build/logs/$preset-configure.log"
}

# build PRESET [TARGET...]
build() {
  local preset=$1
  shift
  local targets=()
  (($#)) && targets=(--target "$@")
  quietly "build/logs/$preset-build.log" \
    cmake --build --preset "$preset" --parallel "$jobs" "${targets[@]}" ||
    fail "the $preset preset does not build; see build/logs/$preset-build.log"
}

# run_tests PRESET [CTEST ARGUMENT...]: prints failures, reasons of skips and, last, the counts.
# With OSTINET_SECOND_CHANCE set, a test that fails is run up to twice more, and named if it passes
# then.
run_tests() {
  local preset=$1 log="build/logs/$1-test.log" status=0
  shift
  [[ -z ${OSTINET_SECOND_CHANCE:-} ]] || set -- --repeat until-pass:3 "$@"
  # A test that fails shows its output; a skipped one tells its reason in the same place.
  "${run_with[@]}" ctest --preset "$preset" --parallel "$jobs" --no-tests=error --output-junit \
    "$tree/build/logs/$preset-test.xml" "$@" >"$log" 2>&1 </dev/null || status=$?
  ((status != 0)) ||
    sed -n '/\*\*\*Skipped/d; s/.*Test *#[0-9]*: \([^ ]*\) .*\*\*\*.*/failed at first: \1/p' "$log"
  python3 scripts/lib/test-summary.py "build/logs/$preset-test.xml" "$log" || status=1
  return "$status"
}

# sources PATTERN...: our own files that match.
sources() {
  if git rev-parse --git-dir >/dev/null 2>&1; then
    git ls-files -co --exclude-standard -- "$@"
  else
    local pattern
    for pattern; do
      find . -path ./build -prune -o -type f -path "./$pattern" -printf '%P\n'
    done
  fi
}
