#!/usr/bin/env bash
# The battery on a third-party plug-in: it must run to completion (a closing
# "N passed, N failed" line and exit status 0 or 1, never a crash); what the
# plug-in fails is printed, not judged.
#
#   lsp_validate.sh --cli BRAKMORPH [--plugin PATH]
set -uo pipefail

cli="" plugin=/usr/lib/vst/lsp-plugins/mb-compressor-stereo.so
while [ $# -gt 0 ]; do
  case "$1" in
    --cli) cli=$2; shift 2 ;;
    --plugin) plugin=$2; shift 2 ;;
    *) echo "unknown argument $1" >&2; exit 2 ;;
  esac
done
[ -n "$cli" ] || { echo "usage: see the head of $0" >&2; exit 2; }
[ -f "$plugin" ] || { echo "SKIP: $plugin not installed"; exit 77; }

log=$(mktemp) out=$(mktemp)
trap 'rm -f "$log" "$out"' EXIT
echo "\$ $cli validate --plugin $plugin --strictness 10"
# The plug-in's own console chatter goes to a file; the battery's lines are shown.
timeout 500 "$cli" validate --plugin "$plugin" --strictness 10 > "$out" 2> "$log"
status=$?
cat "$out"
echo "(exit status $status; the plug-in wrote $(wc -l < "$log") lines to standard error)"
if [ "$status" -ne 0 ] && [ "$status" -ne 1 ]; then
  echo "FAIL: the battery did not run to completion (status $status)" >&2
  exit 1
fi
if ! tail -1 "$out" | grep -Eq '^[0-9]+ passed, [0-9]+ failed$'; then
  echo "FAIL: no closing line" >&2
  exit 1
fi
exit 0
