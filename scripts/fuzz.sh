#!/usr/bin/env bash
# Builds the libFuzzer targets with clang and runs each for a bounded time (not part of CI).
#   scripts/fuzz.sh [SECONDS_PER_TARGET] [TARGET...]     (default 60 s, every target)
# Corpora are kept in fuzz-out/<target>/ (seeded from fuzz/seeds/<target>/ where present),
# crashes in fuzz-out/<target>-crashes/. QUORVEX_FUZZ_BUILD names the build tree (default
# build-fuzz), so that several people fuzzing on one machine do not share one; only the targets
# asked for are built.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
seconds=${1:-60}
shift || true
targets=("$@")
[ ${#targets[@]} -gt 0 ] || targets=(xml_reader_fuzz stored_form_decode_fuzz base64_decode_fuzz
                                   date_parse_fuzz zstream_decode_fuzz class_read_fuzz
                                   transfer_syntax_list_fuzz sop_document_fuzz dicom_document_fuzz
                                   storage_topology_fuzz xml_direct_reader_fuzz
                                   service_request_fuzz)
build=${QUORVEX_FUZZ_BUILD:-$root/build-fuzz}
"$root/scripts/install-deps.sh"
CC=clang CXX=clang++ BUILD_TARGETS="${targets[*]}" "$root/scripts/build.sh" "$build" \
  -DQUORVEX_FUZZ=ON -DQUORVEX_TESTS=OFF -DQUORVEX_BENCH=OFF
for t in "${targets[@]}"; do
  corpus="$root/fuzz-out/$t"
  crashes="$root/fuzz-out/$t-crashes"
  mkdir -p "$corpus" "$crashes"
  echo "=== $t for ${seconds}s"
  seeds=()
  [ -d "$root/fuzz/seeds/$t" ] && seeds=("$root/fuzz/seeds/$t")
  # The class reader starts from the classes' sample documents.
  [ "$t" = class_read_fuzz ] && seeds=("$root/tests/data/classes" "$root/tests/data/fields")
  # Whole SOP service documents start from the samples.
  [ "$t" = sop_document_fuzz ] && seeds=("$root/examples/dicom" "$root/tests/data/dicom")
  # The DICOM service documents start from the example site and the classes' samples.
  [ "$t" = dicom_document_fuzz ] && seeds=("$root/examples/site" "$root/tests/data/classes")
  [ "$t" = storage_topology_fuzz ] && seeds=("$root/examples/site" "$root/tests/data/classes")
  # The one-pass reader starts from printed trees: the element-tree seeds and the samples.
  [ "$t" = xml_direct_reader_fuzz ] &&
    seeds=("$root/fuzz/seeds/xml_reader_fuzz" "$root/tests/data/classes" "$root/examples/site")
  "$build/fuzz/$t" -max_total_time="$seconds" -max_len=65536 -rss_limit_mb=2048 \
    -artifact_prefix="$crashes/" -print_final_stats=1 "$corpus" "${seeds[@]}" 2>&1 | tail -n 12
done
