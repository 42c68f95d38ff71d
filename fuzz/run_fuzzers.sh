#!/usr/bin/env bash
# Runs every fuzz target for a bounded time; any crash fails the run.
set -euo pipefail
build_dir=$1
seconds=${2:-30}
corpus_root=$(mktemp -d)
trap 'rm -rf "$corpus_root"' EXIT
for target in "$build_dir"/fuzz_*; do
  [ -x "$target" ] || continue
  name=$(basename "$target")
  mkdir -p "$corpus_root/$name"
  seeds="$(dirname "$0")/seeds/$name"
  [ -d "$seeds" ] && cp "$seeds"/* "$corpus_root/$name"/ 2>/dev/null || true
  echo "fuzzing $name for ${seconds}s"
  "$target" -max_total_time="$seconds" -max_len=4096 -print_final_stats=1 "$corpus_root/$name" 2>&1 | tail -n 12
  echo "$name: no crash"
done
