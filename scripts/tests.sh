# Shell functions of ./test. Sourced behind packages.sh.

# Runs the tests of a preset, and tells how many of them were skipped and why: a test that needs
# data or programs that are not here passes otherwise, and would be taken for one that ran.
run_tests() {
  local preset="$1" results="$root/build/$1/test-results" status=0
  rm -rf "$results"
  GTEST_OUTPUT="xml:$results/" ctest --preset "$preset" --parallel "$(nproc)" </dev/null || status=$?
  tell_skipped "$results"
  return $status
}

# "3 tests were skipped:", and a line a reason, from the result files of a folder.
tell_skipped() {
  local reasons
  reasons="$(cat "$1"/*.xml 2>/dev/null |
    sed -n 's/.*<skipped message="\([^"]*\)".*/\1/p' |
    sed 's/.*&#x0A;//; s/^ *//' | sort | uniq -c | sort -rn)"
  if [[ -z "$reasons" ]]; then
    echo "No test was skipped"
    return
  fi
  awk '{ n += $1 } END { print n " tests were skipped:" }' <<<"$reasons"
  sed 's/^ *\([0-9]*\) /  \1  /' <<<"$reasons"
}
