#!/usr/bin/env bash
# Runs a command on a private virtual X server (24-bit colour, room for any
# editor), for the tests that open real windows.
#
#   run_under_xvfb.sh COMMAND [ARG]...
#
# Exit 77 (skipped) when xvfb-run is not installed.
set -euo pipefail
if ! command -v xvfb-run > /dev/null 2>&1; then
  echo "SKIP: xvfb-run is not installed"
  exit 77
fi
exec xvfb-run -a -s "-screen 0 1280x1024x24 -nolisten tcp" "$@"
