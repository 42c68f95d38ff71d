#!/usr/bin/env bash
# The threaded checks of brakmorph validate under ThreadSanitizer: Brakmorph
# must pass them with no race reported, and the faulty plug-in whose
# instances share a filter must be reported, which shows the detector is live.
#
#   tsan_validate.sh BUILD_DIR   (a tree configured with -DBRAKMORPH_SANITIZE=thread)
set -uo pipefail

build=${1:?usage: tsan_validate.sh BUILD_DIR}
cli="$build/bin/brakmorph"
export TSAN_OPTIONS="halt_on_error=1 exitcode=66 second_deadlock_stack=1"
failures=0

echo "\$ $cli validate --plugin $build/vst/Brakmorph.so --only lifecycle,threads --strictness 10"
"$cli" validate --plugin "$build/vst/Brakmorph.so" --only lifecycle,threads --strictness 10
status=$?
if [ "$status" -ne 0 ]; then
  echo "FAIL: Brakmorph under ThreadSanitizer exited $status (66: a race was reported)" >&2
  failures=$((failures + 1))
fi

log=$(mktemp)
VALIDATE_FAKE_FAULT=shared_state "$cli" validate --plugin "$build/test_plugins/ValidateFaulty.so" \
  --only lifecycle > "$log" 2>&1
status=$?
if [ "$status" -eq 66 ] && grep -q "ThreadSanitizer: data race" "$log"; then
  echo "ok: the detector reports the faulty plug-in's shared filter"
else
  echo "FAIL: no race reported for instances sharing a filter (status $status)" >&2
  cat "$log" >&2
  failures=$((failures + 1))
fi
rm -f "$log"
exit $((failures > 0))
