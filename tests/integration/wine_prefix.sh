# Sourced by the scripts that run the Windows builds under Wine.
#   windows_unavailable REASON   skip (exit 77), or fail when BRAKMORPH_REQUIRE_WINDOWS=1
#   wine_prefix_ready DIR        export the shared prefix at DIR, setting it up on first use
# The prefix is shared by every Wine test of a build tree; ctest keeps them apart
# with a resource lock.

windows_unavailable() {
  echo "SKIP: $1"
  if [ "${BRAKMORPH_REQUIRE_WINDOWS:-0}" = 1 ]; then
    echo "FAIL: BRAKMORPH_REQUIRE_WINDOWS=1 and $1" >&2
    exit 1
  fi
  exit 77
}

wine_prefix_ready() {
  mkdir -p "$(dirname "$1")"
  export WINEPREFIX=$(cd "$(dirname "$1")" && pwd)/$(basename "$1")
  export WINEDEBUG=-all
  export WINEDLLOVERRIDES="mscoree,mshtml="
  export WINEARCH=win64
  unset DISPLAY WAYLAND_DISPLAY
  trap 'wineserver -k > /dev/null 2>&1 || true' EXIT
  if [ ! -f "$WINEPREFIX/.prefix-ready" ]; then
    rm -rf "$WINEPREFIX"
    echo "setting up the Wine prefix $WINEPREFIX (first run only)"
    timeout 600 wineboot -i > /dev/null 2>&1 || { echo "FAIL: wineboot -i failed" >&2; exit 1; }
    timeout 120 wineserver -w || true
    touch "$WINEPREFIX/.prefix-ready"
  fi
}
