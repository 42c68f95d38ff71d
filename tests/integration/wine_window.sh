#!/usr/bin/env bash
# The editor window of each Windows build on a desktop: win_window_test.exe
# under Wine, on a private X server (xvfb-run). It shows the skin scene in a
# host-like window, posts clicks, drags, keys and menu choices, and compares
# screenshots with the off-screen rendering; they land in <build>/screenshots.
#
#   wine_window.sh --prefix DIR --windows-builds DIR1:DIR2
#
# Shares the Wine prefix of the other Wine tests. Exit 77 (skipped) when the
# Windows builds, Wine or Xvfb are missing, or no window can be shown, unless
# BRAKMORPH_REQUIRE_WINDOWS=1.
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
. "$(dirname "$0")/wine_prefix.sh"

IFS=':' read -r -a build_dirs <<< "$windows_builds"
[ ${#build_dirs[@]} -gt 0 ] || windows_unavailable "no Windows build folders configured"
for dir in "${build_dirs[@]}"; do
  [ -f "$dir/bin/win_window_test.exe" ] || windows_unavailable "$dir/bin/win_window_test.exe missing (make win32 win64)"
done
command -v wine > /dev/null || windows_unavailable "wine not installed"
command -v xvfb-run > /dev/null || windows_unavailable "xvfb-run not installed"

wine_prefix_ready "$prefix"

# The private X server has no window manager, and Wine waits up to 2 s for the
# manager to withdraw each activated window it destroys (line editors, dialogs).
# Windows Wine leaves unmanaged skip that wait; the setting is this program's only.
timeout 120 wine reg add 'HKCU\Software\Wine\AppDefaults\win_window_test.exe\X11 Driver' \
  /v Managed /t REG_SZ /d N /f > /dev/null 2>&1 || echo "note: could not make the test's windows unmanaged"
wineserver -k > /dev/null 2>&1

failures=0
for dir in "${build_dirs[@]}"; do
  build=$(basename "$dir")
  shots=$(cd "$dir" && pwd)/screenshots
  mkdir -p "$shots"
  echo "== $build"
  # A fresh X server per build; the wineserver that starts with it is stopped
  # with it, so the next build's programs talk to the next server.
  xvfb-run -a -s "-screen 0 1024x768x24 -nolisten tcp" \
    bash -c 'timeout 120 wine "$1" "Z:${2//\//\\}"; code=$?; wineserver -k; exit $code' _ \
    "$dir/bin/win_window_test.exe" "$shots" 2>&1 | tr -d '\r'
  code=${PIPESTATUS[0]}
  case $code in
    0) echo "$build: window checks passed; screenshots in $shots" ;;
    77) windows_unavailable "$build: no window could be shown under Wine" ;;
    *) echo "FAIL: $build: win_window_test exited with $code" >&2; failures=$((failures + 1)) ;;
  esac
done
[ "$failures" -eq 0 ] || exit 1
echo "window checks passed on ${#build_dirs[@]} Windows builds"
