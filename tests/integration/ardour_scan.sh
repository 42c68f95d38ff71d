#!/usr/bin/env bash
# A third-party host must index the plug-in: runs Ardour's VST 2 scanner on the
# Linux module and checks what it records in its cache file (name, two inputs,
# two outputs, processReplacing, effect rather than instrument, unique id).
# The scanner's console output and the cache file are printed in full.
#
#   ardour_scan.sh --plugin Brakmorph.so --work DIR [--scanner PATH]
#
# Exit 77 (skipped) when the scanner is not installed.
set -euo pipefail

plugin="" work="" scanner=""
while [ $# -gt 0 ]; do
  case "$1" in
    --plugin) plugin=$2; shift 2 ;;
    --work) work=$2; shift 2 ;;
    --scanner) scanner=$2; shift 2 ;;
    *) echo "unknown argument $1" >&2; exit 2 ;;
  esac
done
[ -n "$plugin" ] && [ -n "$work" ] || { echo "usage: see the head of $0" >&2; exit 2; }

if [ -z "$scanner" ]; then
  for candidate in /usr/lib/ardour*/ardour-vst-scanner; do
    [ -x "$candidate" ] && scanner=$candidate
  done
fi
if [ -z "$scanner" ] || [ ! -x "$scanner" ]; then
  echo "SKIP: no ardour-vst-scanner installed"
  exit 77
fi
[ -f "$plugin" ] || { echo "FAIL: $plugin not built" >&2; exit 1; }

plugin=$(cd "$(dirname "$plugin")" && pwd)/$(basename "$plugin")
# The scanner keeps its cache under $XDG_CACHE_HOME; a private one keeps the
# test away from the user's own cache and from stale entries.
rm -rf "$work"
mkdir -p "$work/cache"
export XDG_CACHE_HOME="$work/cache"
unset DISPLAY WAYLAND_DISPLAY

echo "\$ LD_LIBRARY_PATH=$(dirname "$scanner") $scanner -v -f $plugin"
status=0
LD_LIBRARY_PATH="$(dirname "$scanner")${LD_LIBRARY_PATH:+:$LD_LIBRARY_PATH}" \
  timeout 120 "$scanner" -v -f "$plugin" > "$work/scanner.log" 2>&1 || status=$?
cat "$work/scanner.log"
if [ "$status" -ne 0 ]; then
  echo "FAIL: the scanner exited with status $status" >&2
  exit 1
fi

cache=$(sed -n 's/^.*Saved VST2 plugin cache to //p' "$work/scanner.log" | tail -1)
if [ -z "$cache" ] || [ ! -f "$cache" ]; then
  cache=$(find "$work/cache" -name '*.v2i' | head -1)
fi
if [ -z "$cache" ] || [ ! -f "$cache" ]; then
  echo "FAIL: the scanner wrote no cache file" >&2
  exit 1
fi
echo "--- $cache"
cat "$cache"
echo "---"

failures=0
attribute() {
  # Value of attribute $1 of the first VST2Info element.
  sed -n "s/.*<VST2Info [^>]*\\b$1=\"\\([^\"]*\\)\".*/\\1/p" "$cache" | head -1
}
expect() {
  local actual
  actual=$(attribute "$1")
  if [ "$actual" = "$2" ]; then
    echo "ok: $1=\"$actual\""
  else
    echo "FAIL: $1 is \"$actual\", expected \"$2\"" >&2
    failures=$((failures + 1))
  fi
}

infos=$(grep -c '<VST2Info ' "$cache" || true)
if [ "$infos" -ne 1 ]; then
  echo "FAIL: $infos plug-in entries in the cache, expected 1" >&2
  failures=$((failures + 1))
fi
grep -q "binary=\"$plugin\"" "$cache" || { echo "FAIL: the cache names another binary" >&2; failures=$((failures + 1)); }
expect name Brakmorph
expect n_inputs 2
expect n_outputs 2
expect can_process_replace 1
expect is_instrument 0
# 'Vbmx' read as a big-endian 32-bit number.
expect id $(( (0x56 << 24) | (0x62 << 16) | (0x6D << 8) | 0x78 ))

[ "$failures" -eq 0 ] || exit 1
echo "the scanner indexed the plug-in"
