#!/usr/bin/env bash
# The Windows plug-ins must sound like the Linux one. Renders one fixed 3-second
# input through the Linux module (with `brakmorph render`) and through each
# Windows DLL (with win_render_host.exe under Wine) for a few settings, and
# requires every sample to agree within 1e-5. Also checks each DLL's imports
# (system DLLs only), exports (main and VSTPluginMain) and embedded preset banks.
#
#   wine_cross_build.sh --cli BRAKMORPH --tool RAW_SIGNAL_TOOL --plugin Brakmorph.so
#                       --work DIR --windows-builds DIR1:DIR2
#
# Exit 77 (skipped) when the Windows builds or Wine are missing, unless
# BRAKMORPH_REQUIRE_WINDOWS=1, which turns that into a failure.
set -euo pipefail

TOLERANCE=1e-5
RATE=48000
BLOCK=500  # not a multiple of the engine's internal chunk of 256

cli="" tool="" plugin="" work="" windows_builds=""
while [ $# -gt 0 ]; do
  case "$1" in
    --cli) cli=$2; shift 2 ;;
    --tool) tool=$2; shift 2 ;;
    --plugin) plugin=$2; shift 2 ;;
    --work) work=$2; shift 2 ;;
    --windows-builds) windows_builds=$2; shift 2 ;;
    *) echo "unknown argument $1" >&2; exit 2 ;;
  esac
done
for required in "$cli" "$tool" "$plugin" "$work"; do
  [ -n "$required" ] || { echo "usage: see the head of $0" >&2; exit 2; }
done

. "$(dirname "$0")/wine_prefix.sh"

failures=0
fail() {
  echo "FAIL: $*" >&2
  failures=$((failures + 1))
}

# The Windows builds named by the Linux configuration.
dlls=() hosts=() arches=()
IFS=':' read -r -a build_dirs <<< "$windows_builds"
[ ${#build_dirs[@]} -gt 0 ] || windows_unavailable "no Windows build folders configured (BRAKMORPH_WINDOWS_BUILDS)"
for dir in "${build_dirs[@]}"; do
  dll="$dir/vst/Brakmorph.dll"
  host="$dir/bin/win_render_host.exe"
  [ -f "$dll" ] || windows_unavailable "$dll missing (make win32 win64)"
  [ -f "$host" ] || windows_unavailable "$host missing (make win32 win64)"
  dlls+=("$dll")
  hosts+=("$host")
done
command -v wine > /dev/null || windows_unavailable "wine not installed"
command -v x86_64-w64-mingw32-objdump > /dev/null || windows_unavailable "mingw-w64 binutils not installed"
command -v x86_64-w64-mingw32-windres > /dev/null || windows_unavailable "mingw-w64 windres not installed"

mkdir -p "$work"
work=$(cd "$work" && pwd)

# ---------------------------------------------------------------------------
# Static checks of each DLL.

# Windows' own DLLs (and the C runtime every Windows has); nothing from the
# toolchain (libstdc++, libgcc, libwinpthread) may be needed at run time.
system_dll_pattern='^(KERNEL32|USER32|GDI32|WINMM|ADVAPI32|SHELL32|COMDLG32|COMCTL32|OLE32|OLEAUT32|UUID|SHLWAPI|VERSION|MSIMG32|MSVCRT|UCRTBASE|API-MS-WIN-[A-Z0-9-]+)\.DLL$'

for index in "${!dlls[@]}"; do
  dll=${dlls[$index]}
  format=$(x86_64-w64-mingw32-objdump -f "$dll" | sed -n 's/.*file format \(.*\)$/\1/p' | head -1)
  case "$format" in
    pei-i386) arches[index]=win32 ;;
    pei-x86-64) arches[index]=win64 ;;
    *) fail "$dll: unexpected file format '$format'"; arches[index]=unknown; continue ;;
  esac
  arch=${arches[$index]}
  echo "== $arch: $dll ($format)"
  headers=$(x86_64-w64-mingw32-objdump -p "$dll")

  imports=$(sed -n 's/^[[:space:]]*DLL Name: //p' <<< "$headers" | tr '[:lower:]' '[:upper:]' | sort -u)
  echo "imports: $(echo $imports)"
  [ -n "$imports" ] || fail "$arch: no import table found"
  for imported in $imports; do
    grep -Eq "$system_dll_pattern" <<< "$imported" || fail "$arch imports non-system DLL $imported"
  done

  # The export name table lists "[ordinal] name" rows after its heading.
  exports=$(awk '/\[Ordinal\/Name Pointer\] Table/ {on = 1; next} on && /^[[:space:]]*\[/ {print $NF; next} on {on = 0}' <<< "$headers" | sort -u)
  echo "exports: $(echo $exports)"
  for wanted in main VSTPluginMain; do
    grep -qx "$wanted" <<< "$exports" || fail "$arch does not export $wanted"
  done

  # Both bank resources must hold exactly the generated factory bank: compare
  # the resource script windres decompiles from the DLL with the one it
  # decompiles from a reference built from the bank file.
  resources="$work/$arch.resources.rc"
  if ! x86_64-w64-mingw32-windres -J coff -i "$dll" -O rc -o "$resources" 2> "$work/$arch.windres.log"; then
    fail "$arch: cannot read the resources: $(cat "$work/$arch.windres.log")"
    continue
  fi
  for name in DEFAULT_PRESET_BANK STATIC_PRESETS; do
    grep -q "^\"$name\" \"VLPB\"" "$resources" || fail "$arch: resource $name of type VLPB missing"
  done
  echo "resources of type VLPB: $(sed -n 's/^"\([A-Z_]*\)" "VLPB"$/\1/p' "$resources" | tr '\n' ' ')"
done

# The factory bank the Linux tree generated is what both DLLs embed.
bank="$(dirname "$(dirname "$plugin")")/gen/factory_bank.pbk"
if [ -f "$bank" ]; then
  reference_rc="$work/reference_banks.rc"
  printf 'DEFAULT_PRESET_BANK VLPB "%s"\nSTATIC_PRESETS VLPB "%s"\n' "$bank" "$bank" > "$reference_rc"
  x86_64-w64-mingw32-windres -i "$reference_rc" -O coff -o "$work/reference_banks.o"
  x86_64-w64-mingw32-windres -J coff -i "$work/reference_banks.o" -O rc -o "$work/reference_banks.out.rc"
  # Keep only the two bank resources' bodies, in name order, from each script.
  bank_bodies() {
    awk '/^"[A-Z_]+" "VLPB"/ {name = $1; keep = 1} keep {print name, $0} /^END/ {keep = 0}' "$1" | sort -s -k1,1
  }
  bank_bodies "$work/reference_banks.out.rc" > "$work/reference_banks.body"
  for index in "${!dlls[@]}"; do
    arch=${arches[$index]}
    [ -f "$work/$arch.resources.rc" ] || continue
    bank_bodies "$work/$arch.resources.rc" > "$work/$arch.banks.body"
    if cmp -s "$work/reference_banks.body" "$work/$arch.banks.body"; then
      echo "$arch: both VLPB resources equal $bank ($(stat -c %s "$bank") bytes)"
    else
      fail "$arch: the VLPB resources differ from $bank"
    fi
  done
else
  fail "generated factory bank $bank not found"
fi

# ---------------------------------------------------------------------------
# Wine: a private prefix under the build folder, set up once.

wine_prefix_ready "$work/prefix"

# Wine maps the Unix root to drive Z:.
windows_path() {
  printf 'Z:%s' "${1//\//\\}"
}

run_windows() {
  timeout 300 wine "$@"
}

# ---------------------------------------------------------------------------
# The same answers to the host on every platform.

info_line() {
  # "key value" from win_render_host --info
  awk -v key="$2" '$1 == key {print $2}' <<< "$1"
}

linux_info=$("$cli" info --plugin "$plugin" --json)
linux_summary=""
for key in numParams numPrograms numInputs numOutputs uniqueID; do
  case $key in
    numParams) value=$(jq '.parameters | length' <<< "$linux_info") ;;
    numPrograms) value=$(jq '.programs | length' <<< "$linux_info") ;;
    numInputs) value=$(jq '.num_inputs' <<< "$linux_info") ;;
    numOutputs) value=$(jq '.num_outputs' <<< "$linux_info") ;;
    uniqueID) value=$(jq '.unique_id_number' <<< "$linux_info") ;;
  esac
  linux_summary+="$key $value "
done
echo "linux: $linux_summary"

for index in "${!dlls[@]}"; do
  arch=${arches[$index]}
  if ! info=$(run_windows "${hosts[$index]}" "$(windows_path "${dlls[$index]}")" --info 2> "$work/$arch.info.err"); then
    fail "$arch: win_render_host --info failed: $(cat "$work/$arch.info.err")"
    continue
  fi
  info=$(tr -d '\r' <<< "$info")
  summary=""
  for key in numParams numPrograms numInputs numOutputs uniqueID; do
    summary+="$key $(info_line "$info" $key) "
  done
  echo "$arch: $summary"
  [ "$summary" = "$linux_summary" ] || fail "$arch answers differently from Linux"
done

# ---------------------------------------------------------------------------
# Renders.

input="$work/input.raw"
"$tool" generate "$input" "$RATE" 3

# name | program | normalised settings by index: 1 Oversampling, 5 Fdbk Amnt,
# 6 Fdbk Freq, 3 Tone Shape, 2 Tone Freq
cases=(
  "program0|0|"
  "program3|3|"
  "program3-os-fdbk-tone|3|1=1 5=0.5 6=0.4 3=0.8 2=0.3"
)

for entry in "${cases[@]}"; do
  IFS='|' read -r name program norms <<< "$entry"
  norm_args=()
  for assignment in $norms; do
    norm_args+=(--norm "$assignment")
  done
  reference="$work/$name.linux.raw"
  rm -f "$reference"
  if ! "$cli" render --plugin "$plugin" --raw-in "$input" --raw-out "$reference" \
      --rate "$RATE" --block "$BLOCK" --program "$program" "${norm_args[@]}" > "$work/$name.linux.log" 2>&1; then
    fail "$name: Linux render failed: $(cat "$work/$name.linux.log")"
    continue
  fi
  for index in "${!dlls[@]}"; do
    arch=${arches[$index]}
    output="$work/$name.$arch.raw"
    rm -f "$output"
    started=$(date +%s.%N)
    if ! run_windows "${hosts[$index]}" "$(windows_path "${dlls[$index]}")" \
        "$(windows_path "$input")" "$(windows_path "$output")" \
        --rate "$RATE" --block "$BLOCK" --program "$program" "${norm_args[@]}" > "$work/$name.$arch.log" 2>&1; then
      fail "$name: $arch render failed: $(cat "$work/$name.$arch.log")"
      continue
    fi
    seconds=$(awk -v a="$started" -v b="$(date +%s.%N)" 'BEGIN {printf "%.1f", b - a}')
    if result=$("$tool" compare "$reference" "$output" "$TOLERANCE" 2>&1); then
      echo "$name $arch vs linux: $result (wine run ${seconds} s)"
    else
      fail "$name $arch vs linux: $result"
    fi
  done
done

# Each setting must change the sound, or the comparisons above could pass with
# settings that never reached the plug-in.
previous="$input"
for entry in "${cases[@]}"; do
  name=${entry%%|*}
  current="$work/$name.linux.raw"
  [ -f "$current" ] || continue
  if result=$("$tool" differ "$previous" "$current" 1e-2 2>&1); then
    echo "$name differs from $(basename "$previous" .raw): $result"
  else
    fail "$name sounds like $(basename "$previous" .raw): $result"
  fi
  previous="$current"
done

if [ "$failures" -ne 0 ]; then
  echo "$failures check(s) failed" >&2
  exit 1
fi
echo "all Windows builds agree with Linux within $TOLERANCE"
