#!/usr/bin/env bash
# Runs the launcher under Wine on the sample disc of a build, on the user's display when
# there is one (until the launcher is closed), else on Xvfb for a little while; either way
# it saves a screenshot.
#   demo.sh BUILD_DIR [SECONDS_ON_XVFB]
# The launcher's command line comes from AUTOPLAY_ARGS (for example -l0411 for Japanese).
set -euo pipefail
build=$(cd "$1" && pwd)
seconds=${2:-12}
here=$(cd "$(dirname "$0")/.." && pwd)
STATE="$build/demo-wine"
disc="$build/disc"
shot="$build/demo-screenshot.png"

if [ ! -f "$disc/AutoPlay.exe" ]; then
    # No sample disc in this build: run what there is.
    disc="$build/demo-folder"
    mkdir -p "$disc"
    cp "$build/bin/AutoPlay.exe" "$disc/"
fi

own_display=${DISPLAY:-}
"$here/tests/wine/prefix.sh" setup "$STATE" >/dev/null
trap '"$here/tests/wine/prefix.sh" cleanup "$STATE" >/dev/null 2>&1 || true' EXIT
source "$here/tests/wine/env.sh"

cd "$disc"
echo "Running $disc/AutoPlay.exe on display $DISPLAY"
"$WINE" "$disc/AutoPlay.exe" ${AUTOPLAY_ARGS:-} >"$STATE/demo.log" 2>&1 &
launcher=$!
sleep 6
import -display "$DISPLAY" -window root "$shot" 2>/dev/null && echo "Screenshot: $shot"
if [ -n "$own_display" ]; then
    echo "Close the launcher (its Exit button or Alt+F4) to end the demo."
    wait "$launcher" || true
else
    sleep "$seconds"
    import -display "$DISPLAY" -window root "$shot" 2>/dev/null && echo "Screenshot: $shot"
    kill "$launcher" 2>/dev/null || true
fi
