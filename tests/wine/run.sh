#!/usr/bin/env bash
# Runs one Windows test program under Wine in the test run's prefix (CTest's emulator).
#   run.sh STATE PROGRAM [ARGS...]
# Wine's helper processes outlive the program; they write to a file, never to CTest's pipes.
set -uo pipefail
STATE=$1
shift
source "$(dirname "$0")/env.sh"
log="$(mktemp)"
timeout --kill-after=10 "${AUTOPLAY_TEST_TIMEOUT:-900}" "$WINE" "$@" </dev/null >"$log" 2>&1
status=$?
cat "$log"
rm -f "$log"
exit $status
