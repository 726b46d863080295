#!/usr/bin/env bash
# The demo session end to end, as a new user meets it: two runs in one folder (the second keeps
# the settings and reads pages from the cache), every step in the transcript, and a storefront
# page whose box-art images all load in a headless browser.
set -euo pipefail
build=${1:?usage: demo_test.sh BUILD_FOLDER}
dir=$(mktemp -d)
trap 'rm -rf "$dir"' EXIT
here=$(cd "$(dirname "$0")" && pwd)

fail() { echo "demo_test: $*" >&2; exit 1; }
for run in 1 2; do
  "$here/../demo/run-demo" "$build" "$dir/demo" > "$dir/run$run.txt" || fail "run $run failed: $(cat "$dir/run$run.txt")"
done
grep -q '^    created: ' "$dir/run1.txt" || fail "the first run made no settings file"
grep -q '^    kept from the last run: ' "$dir/run2.txt" || fail "the second run lost the settings file"
for step in 'genres; top level' 'page 2 of .*fetched in the background' 'Details of' 'A series:' 'Search for' \
            'images in' 'device authorised' 'token stored encrypted: true' 'on the wishlist:' 'with the saved card' \
            'stream STREAM-' 'Bandwidth:' 'token removed from the settings: true' 'store calls in' \
            'answers read from the cache: [1-9]'; do
  grep -q -e "$step" "$dir/run2.txt" || fail "no \"$step\" in the transcript: $(cat "$dir/run2.txt")"
done
grep -q 'VL_WS_getTitles' "$dir/demo/settings/log.txt" || fail "the library's log is empty"

loaded=$(HOME="$dir" chromium --headless --no-sandbox --disable-gpu --user-data-dir="$dir/browser" \
           --virtual-time-budget=5000 --dump-dom "file://$dir/demo/storefront.html" 2>/dev/null |
         grep -o 'data-loaded="[0-9]*/[0-9]*"' || true)
[[ $loaded =~ data-loaded=\"([0-9]+)/([0-9]+)\" ]] && [ "${BASH_REMATCH[1]}" = "${BASH_REMATCH[2]}" ] &&
  [ "${BASH_REMATCH[1]}" -gt 0 ] || fail "the storefront's images did not all load: ${loaded:-no count}"
echo "demo_test: both runs complete, ${BASH_REMATCH[1]} images on the storefront page"
