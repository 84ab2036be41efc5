#!/usr/bin/env bash
# Makes (setup) or tears down (cleanup) the Wine prefix and X display of one test run.
#   prefix.sh setup|cleanup STATE [DEPTH]
# A display is started with Xvfb when none is set, or when a DEPTH is asked for (the
# 256-colour runs). Every wait here has a bound.
set -euo pipefail
command=$1
STATE=$2
depth=${3:-}

start_xvfb() {
    local n
    for n in $(seq 90 160); do
        [ -e "/tmp/.X$n-lock" ] && continue
        setsid Xvfb ":$n" -screen 0 "1024x768x${depth:-24}" -nolisten tcp </dev/null >"$STATE/xvfb.log" 2>&1 &
        echo $! >"$STATE/xvfb.pid"
        for _ in $(seq 1 100); do
            if [ -S "/tmp/.X11-unix/X$n" ]; then
                echo ":$n" >"$STATE/display"
                return 0
            fi
            kill -0 "$(cat "$STATE/xvfb.pid")" 2>/dev/null || break
            sleep 0.1
        done
        kill "$(cat "$STATE/xvfb.pid")" 2>/dev/null || true
    done
    echo "no X display could be started" >&2
    return 1
}

case "$command" in
    setup)
        if [ -d "$STATE" ]; then "$0" cleanup "$STATE" || true; fi
        rm -rf "$STATE"
        mkdir -p "$STATE"
        if [ -z "${DISPLAY:-}" ] || [ -n "$depth" ]; then start_xvfb; fi
        source "$(dirname "$0")/env.sh"
        # A persistent server keeps each test's start quick; its output must not hold
        # CTest's pipes open.
        setsid "$WINESERVER" -p </dev/null >/dev/null 2>&1 || true
        timeout 300 "$WINE" wineboot -i </dev/null >"$STATE/wineboot.log" 2>&1
        # The launcher names Windows fonts: Wine is told which free fonts stand in for them.
        # regedit takes names beyond ASCII only from a UTF-16 file.
        { printf '\377\376'; sed 's/$/\r/' "$(dirname "$0")/fonts.reg" | iconv -f UTF-8 -t UTF-16LE; } >"$STATE/fonts.reg"
        (cd "$STATE" && timeout 60 "$WINE" regedit /S fonts.reg </dev/null >>"$STATE/wineboot.log" 2>&1)
        timeout 120 "$WINESERVER" -w || true
        setsid "$WINESERVER" -p </dev/null >/dev/null 2>&1 || true
        echo "Wine prefix ready in $WINEPREFIX on display ${DISPLAY}"
        ;;
    cleanup)
        source "$(dirname "$0")/env.sh"
        timeout 60 "$WINESERVER" -k 2>/dev/null || true
        if [ -f "$STATE/xvfb.pid" ]; then
            kill "$(cat "$STATE/xvfb.pid")" 2>/dev/null || true
            rm -f "$STATE/xvfb.pid" "$STATE/display"
        fi
        ;;
    *)
        echo "usage: $0 setup|cleanup STATE [DEPTH]" >&2
        exit 2
        ;;
esac
