#!/usr/bin/env bash
# The editor of each Windows build under Wine on a virtual X server: the
# Windows test host's snapshot mode grabs the default state and program 5
# into BMPs under OUT (kept for people to look at) and the snapshot test of
# the test binary probes them; the Windows validator's editor checks must
# pass too.
#
#   wine_snapshots.sh --prefix DIR --windows-builds DIR1:DIR2 --out OUT --tests brakmorph_tests
#
# Exit 77 (skipped) when the Windows builds, Wine or xvfb-run are missing
# (a failure under BRAKMORPH_REQUIRE_WINDOWS=1), or when the builds declare
# no editor.
set -uo pipefail

prefix="" windows_builds="" out="" tests=""
while [ $# -gt 0 ]; do
  case "$1" in
    --prefix) prefix=$2; shift 2 ;;
    --windows-builds) windows_builds=$2; shift 2 ;;
    --out) out=$2; shift 2 ;;
    --tests) tests=$2; shift 2 ;;
    *) echo "unknown argument $1" >&2; exit 2 ;;
  esac
done
[ -n "$prefix" ] && [ -n "$out" ] && [ -n "$tests" ] || { echo "usage: see the head of $0" >&2; exit 2; }
. "$(dirname "$0")/../integration/wine_prefix.sh"

IFS=':' read -r -a build_dirs <<< "$windows_builds"
[ ${#build_dirs[@]} -gt 0 ] || windows_unavailable "no Windows build folders configured"
for dir in "${build_dirs[@]}"; do
  [ -f "$dir/vst/Brakmorph.dll" ] || windows_unavailable "$dir/vst/Brakmorph.dll missing (make win32 win64)"
  [ -f "$dir/bin/win_render_host.exe" ] || windows_unavailable "$dir/bin/win_render_host.exe missing"
  [ -f "$dir/bin/brakmorph_validate.exe" ] || windows_unavailable "$dir/bin/brakmorph_validate.exe missing"
done
command -v wine > /dev/null || windows_unavailable "wine not installed"
command -v xvfb-run > /dev/null || windows_unavailable "xvfb-run not installed"

wine_prefix_ready "$prefix"
mkdir -p "$out"
out=$(cd "$out" && pwd)

windows_path() {
  printf 'Z:%s' "${1//\//\\}"
}
# One X server for every Wine call of a step; the prefix's wineserver goes
# with it, so no Wine process outlives its display.
on_display() {
  wineserver -k > /dev/null 2>&1 || true
  xvfb-run -a -s "-screen 0 1280x1024x24 -nolisten tcp" \
    bash -c '"$@"; status=$?; wineserver -k > /dev/null 2>&1; exit $status' on_display "$@"
}

names=()
failures=0
for dir in "${build_dirs[@]}"; do
  dir=$(cd "$dir" && pwd)
  name=$(basename "$dir")
  host="$dir/bin/win_render_host.exe"
  dll=$(windows_path "$dir/vst/Brakmorph.dll")
  flags=$(timeout 120 wine "$host" "$dll" --info 2>/dev/null | tr -d '\r' | sed -n 's/^flags //p')
  if [ -z "$flags" ]; then
    echo "FAIL: $name: the test host could not load the plug-in" >&2
    failures=$((failures + 1))
    continue
  fi
  if [ $((flags & 1)) -eq 0 ]; then
    echo "SKIP: $name: this build of the plug-in declares no editor"
    exit 77
  fi
  echo "== $name"
  for state in default program5; do
    settings=()
    [ "$state" = program5 ] && settings=(--program 5)
    rm -f "$out/$name-$state.bmp"
    echo "\$ wine win_render_host.exe Brakmorph.dll --snapshot $out/$name-$state.bmp ${settings[*]}"
    on_display timeout 120 wine "$host" "$dll" --snapshot "$(windows_path "$out/$name-$state.bmp")" \
      "${settings[@]}" 2>&1 | tr -d '\r' | grep -v '^ALSA lib'
    if [ ! -s "$out/$name-$state.bmp" ]; then
      echo "FAIL: $name: no $state snapshot" >&2
      failures=$((failures + 1))
    fi
  done
  names+=("$name")
  echo "\$ wine brakmorph_validate.exe --plugin Brakmorph.dll --only editor"
  output=$(on_display timeout 300 wine "$dir/bin/brakmorph_validate.exe" --plugin "$dll" --only editor 2>&1 |
           tr -d '\r' | grep -v '^ALSA lib')
  echo "$output"
  if ! tail -1 <<< "$output" | grep -Eq '^2 passed, 0 failed$'; then
    echo "FAIL: $name: the editor checks did not pass" >&2
    failures=$((failures + 1))
  fi
done
[ "$failures" -eq 0 ] || exit 1

echo "\$ brakmorph_tests --gtest_filter=EditorHostWineSnapshots.*"
BRAKMORPH_WINE_SNAPSHOTS="$out" BRAKMORPH_WINE_SNAPSHOT_NAMES="${names[*]}" \
  "$tests" --gtest_filter='EditorHostWineSnapshots.*' --gtest_brief=1
