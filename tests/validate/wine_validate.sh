#!/usr/bin/env bash
# The validation battery on each Windows build under Wine: the Windows build
# of the validator (brakmorph_validate.exe, from the same Windows tree) runs
# at full strictness against that tree's Brakmorph.dll, and must pass.
#
#   wine_validate.sh --prefix DIR --windows-builds DIR1:DIR2
#
# The Wine prefix is the one the cross-build comparison sets up (same folder,
# same readiness mark); whichever test comes first creates it. Exit 77
# (skipped) when the Windows builds or Wine are missing, unless
# BRAKMORPH_REQUIRE_WINDOWS=1, which turns that into a failure.
set -uo pipefail

prefix="" windows_builds=""
while [ $# -gt 0 ]; do
  case "$1" in
    --prefix) prefix=$2; shift 2 ;;
    --windows-builds) windows_builds=$2; shift 2 ;;
    *) echo "unknown argument $1" >&2; exit 2 ;;
  esac
done
[ -n "$prefix" ] || { echo "usage: see the head of $0" >&2; exit 2; }
. "$(dirname "$0")/../integration/wine_prefix.sh"

IFS=':' read -r -a build_dirs <<< "$windows_builds"
[ ${#build_dirs[@]} -gt 0 ] || windows_unavailable "no Windows build folders configured"
for dir in "${build_dirs[@]}"; do
  [ -f "$dir/vst/Brakmorph.dll" ] || windows_unavailable "$dir/vst/Brakmorph.dll missing (make win32 win64)"
  [ -f "$dir/bin/brakmorph_validate.exe" ] || windows_unavailable "$dir/bin/brakmorph_validate.exe missing"
done
command -v wine > /dev/null || windows_unavailable "wine not installed"

wine_prefix_ready "$prefix"

windows_path() {
  printf 'Z:%s' "${1//\//\\}"
}

failures=0
for dir in "${build_dirs[@]}"; do
  dir=$(cd "$dir" && pwd)
  echo "== $dir"
  echo "\$ wine brakmorph_validate.exe --plugin $dir/vst/Brakmorph.dll --strictness 10"
  output=$(timeout 600 wine "$dir/bin/brakmorph_validate.exe" \
             --plugin "$(windows_path "$dir/vst/Brakmorph.dll")" --strictness 10 2>&1)
  status=$?
  output=$(tr -d '\r' <<< "$output")
  echo "$output"
  if [ "$status" -ne 0 ]; then
    echo "FAIL: the battery exited $status for $dir" >&2
    failures=$((failures + 1))
  elif ! tail -1 <<< "$output" | grep -Eq '^[0-9]+ passed, 0 failed$'; then
    echo "FAIL: no closing line for $dir" >&2
    failures=$((failures + 1))
  fi
done
exit $((failures > 0))
