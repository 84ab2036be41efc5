# Sourced by the Wine scripts: the environment every Wine process of the tests and the
# demo runs in. STATE is the folder that holds the prefix and the display in use.
export WINEPREFIX="$STATE/prefix"
export WINEDEBUG=-all
# Wine must never stop to offer its .NET or HTML engines, nor hold a crashed program in its
# debugger: a crash has to end the test, not hang it. The test machines have no sound card.
export WINEDLLOVERRIDES="mscoree,mshtml=;winedbg.exe=d;winealsa.drv,winepulse.drv=d"
export WINEARCH=win64
# The launcher's system language is US English unless a test says otherwise.
export LANG="${AUTOPLAY_TEST_LANG:-en_US.UTF-8}"
# A display started for the run (none was set, or the run needs a depth of its own) wins.
if [ -f "$STATE/display" ]; then
    DISPLAY="$(cat "$STATE/display")"
    export DISPLAY
fi
# Debian's wine64 runs 64-bit programs; a machine with 32-bit Wine has plain "wine" for both.
WINE="$(command -v wine64 || command -v wine)"
for candidate in /usr/lib/wine/wine64 /usr/lib/wine/wine; do
    [ -x "$candidate" ] && [ -z "${WINE:-}" ] && WINE="$candidate"
done
export WINE
WINESERVER="$(command -v wineserver || echo /usr/lib/wine/wineserver64)"
export WINESERVER
