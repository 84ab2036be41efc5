#!/usr/bin/env bash
# Time from process start to the first painted frame under Wine: the launcher on the sample
# disc against an empty window program, started the same way in the same run; then where the
# launcher's start-up time goes, phase by phase.
#   first-paint.sh BUILD_DIR [RUNS]
set -euo pipefail
build=$(cd "$1" && pwd)
here=$(cd "$(dirname "$0")/.." && pwd)
STATE="$build/first-paint-wine"
"$here/tests/wine/prefix.sh" setup "$STATE" >/dev/null
trap '"$here/tests/wine/prefix.sh" cleanup "$STATE" >/dev/null 2>&1 || true' EXIT
disc="$build/disc"
"$here/tests/wine/run.sh" "$STATE" "$build/bin/first_paint.exe" "Z:${disc//\//\\}" "${2:-7}" |
    grep -v '^ALSA'
"$here/tests/wine/run.sh" "$STATE" "$build/bin/startup_phases.exe" "Z:${disc//\//\\}" "${2:-7}" |
    grep -v '^ALSA'
