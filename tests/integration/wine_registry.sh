#!/usr/bin/env bash
# The per-user values of each Windows build against the real registry under
# Wine: what the store writes, `reg query` must find below
# HKEY_CURRENT_USER\Software, and what `reg add` puts there the store must read.
#
#   wine_registry.sh --prefix DIR --windows-builds DIR1:DIR2
#
# Shares the Wine prefix of the cross-build comparison. Exit 77 (skipped) when
# the Windows builds or Wine are missing, unless BRAKMORPH_REQUIRE_WINDOWS=1.
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
  [ -f "$dir/bin/registry_probe.exe" ] || windows_unavailable "$dir/bin/registry_probe.exe missing (make win32 win64)"
done
command -v wine > /dev/null || windows_unavailable "wine not installed"

wine_prefix_ready "$prefix"

failures=0
check() {  # check DESCRIPTION EXPECTED ACTUAL
  if [ "$2" = "$3" ]; then
    echo "ok: $1"
  else
    echo "FAIL: $1: expected '$2', got '$3'" >&2
    failures=$((failures + 1))
  fi
}

# The value as `reg query` shows it: the last field of the line naming it.
reg_value() {
  timeout 120 wine reg query "$1" /v "$2" 2>/dev/null | tr -d '\r' | awk -v n="$2" 'index($0, n) { print $NF }'
}

for dir in "${build_dirs[@]}"; do
  probe="$dir/bin/registry_probe.exe"
  build=$(basename "$dir")
  path="Velmora/Brakmorph Probe $build"
  key="HKCU\\Software\\Velmora\\Brakmorph Probe $build"
  timeout 120 wine reg delete "$key" /f > /dev/null 2>&1

  timeout 120 wine "$probe" set "$path" "NRPN Compatibility" 1
  check "$build: a stored value is in the registry" "1" "$(reg_value "$key" "NRPN Compatibility")"
  check "$build: and reads back" "1" "$(timeout 120 wine "$probe" get "$path" "NRPN Compatibility" | tr -d '\r')"

  timeout 120 wine reg add "$key" /v "Autobind Mode" /t REG_SZ /d "maybe" /f > /dev/null 2>&1
  check "$build: an unrecognised switch falls back" "0" \
    "$(timeout 120 wine "$probe" switch "$path" "Autobind Mode" 0 | tr -d '\r')"
  check "$build: and the fallback text replaces it in the registry" "0" "$(reg_value "$key" "Autobind Mode")"

  timeout 120 wine reg add "$key" /v "Autobind Mode" /t REG_SZ /d "1" /f > /dev/null 2>&1
  check "$build: a value written by another program is read" "1" \
    "$(timeout 120 wine "$probe" switch "$path" "Autobind Mode" 0 | tr -d '\r')"
  timeout 120 wine reg delete "$key" /f > /dev/null 2>&1
done

[ "$failures" -eq 0 ] || exit 1
echo "registry checks passed on ${#build_dirs[@]} Windows builds"
