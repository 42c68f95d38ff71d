#!/usr/bin/env bash
# The command-line host must drive another maker's plug-in, not only ours:
# `brakmorph info` and `brakmorph bench` on the stereo multiband compressor of
# the LSP plug-in collection. No timing is asserted, only that each command
# completes and reports what the plug-in declares.
#
#   lsp_bench.sh --cli BRAKMORPH [--peer PATH]
#
# Exit 77 (skipped) when the peer plug-in is not installed.
set -euo pipefail

cli="" peer=""
while [ $# -gt 0 ]; do
  case "$1" in
    --cli) cli=$2; shift 2 ;;
    --peer) peer=$2; shift 2 ;;
    *) echo "unknown argument $1" >&2; exit 2 ;;
  esac
done
[ -n "$cli" ] || { echo "usage: see the head of $0" >&2; exit 2; }

if [ -z "$peer" ]; then
  for candidate in /usr/lib/vst/lsp-plugins/mb-compressor-stereo.so \
                   /usr/lib/lxvst/lsp-plugins/mb-compressor-stereo.so \
                   /usr/lib/vst/lsp-plugins-vst/mb-compressor-stereo.so; do
    if [ -f "$candidate" ]; then
      peer=$candidate
      break
    fi
  done
fi
if [ -z "$peer" ] || [ ! -f "$peer" ]; then
  echo "SKIP: the LSP multiband compressor (lsp-plugins-vst) is not installed"
  exit 77
fi

failures=0
fail() {
  echo "FAIL: $*" >&2
  failures=$((failures + 1))
}

run() {
  echo "\$ $*" >&2
  timeout 120 "$@"
}

# info, as text and as JSON; both must describe the same plug-in.
if ! text=$(run "$cli" info --plugin "$peer"); then
  fail "brakmorph info failed on $peer"
fi
echo "$text" | head -20
if ! json=$(run "$cli" info --plugin "$peer" --json); then
  fail "brakmorph info --json failed on $peer"
  json='{}'
fi
if ! jq -e . > /dev/null <<< "$json"; then
  fail "brakmorph info --json printed invalid JSON"
  json='{}'
fi
name=$(jq -r '.name // empty' <<< "$json")
inputs=$(jq -r '.num_inputs // empty' <<< "$json")
outputs=$(jq -r '.num_outputs // empty' <<< "$json")
params=$(jq -r '.parameters | length' <<< "$json" 2> /dev/null || echo 0)
named=$(jq -r '[.parameters[]? | select((.name // "") != "")] | length' <<< "$json")
id=$(jq -r '.unique_id // empty' <<< "$json")
echo "json: name \"$name\", id '$id', $inputs in, $outputs out, $params parameters ($named named)"
[ -n "$name" ] || fail "no plug-in name"
[ "$inputs" = 2 ] || fail "expected 2 inputs, got '$inputs'"
[ "$outputs" = 2 ] || fail "expected 2 outputs, got '$outputs'"
[ "${#id}" -eq 4 ] || fail "unique id '$id' is not four characters"
[ "$params" -gt 0 ] || fail "no parameters listed"
[ "$named" -eq "$params" ] || fail "$((params - named)) parameters without a name"
text_params=$(sed -n 's/^Parameters:[[:space:]]*\([0-9]*\).*/\1/p' <<< "$text")
[ "$text_params" = "$params" ] || fail "text info lists '$text_params' parameters, JSON $params"
grep -qF "$name" <<< "$text" || fail "text info does not name \"$name\""

# bench on the peer alone, then side by side with our plug-in.
bench_rows() {
  # Rows of the result table: a case name, a block size and three numbers.
  awk '$2 ~ /^[0-9]+$/ && $3 ~ /^[0-9.]+$/ && $4 ~ /^[0-9.]+$/ {print}' <<< "$1"
}
if output=$(run "$cli" bench --plugin "$peer" --seconds 0.25 --runs 3); then
  echo "$output"
  [ "$(bench_rows "$output" | wc -l)" -eq 1 ] || fail "bench on the peer printed no result row"
else
  echo "$output"
  fail "brakmorph bench failed on $peer"
fi
if output=$(run "$cli" bench --seconds 0.25 --runs 3 --compare "$peer"); then
  echo "$output"
  [ "$(bench_rows "$output" | wc -l)" -eq 2 ] || fail "bench --compare did not report both plug-ins"
else
  echo "$output"
  fail "brakmorph bench --compare $peer failed"
fi

[ "$failures" -eq 0 ] || exit 1
echo "brakmorph drives $name"
