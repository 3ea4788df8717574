# Private Wine environment under a build directory: functions shared by
# scripts/wine-run and scripts/wine-stop. Source it; nothing runs on load.
#
# Everything lives in $TAVO_BUILD/wine: the Wine prefix, a private HOME, the
# logs and the pid files of the virtual display and the keeper program.
# Nothing outside the build directory is configured.

tavo_wine_say() { echo "wine-env: $*" >&2; }

# tavo_wine_exports <build dir>: the environment every Wine program runs in.
tavo_wine_exports() {
    TAVO_BUILD=$(cd "$1" && pwd)
    TAVO_WINE="$TAVO_BUILD/wine"
    export HOME="$TAVO_WINE/home"
    export XDG_CONFIG_HOME="$HOME/.config" XDG_CACHE_HOME="$HOME/.cache" XDG_DATA_HOME="$HOME/.local/share"
    export WINEPREFIX="$TAVO_WINE/prefix" WINEARCH=win64 WINEDEBUG=-all
    # winedbg is switched off: a crashing test must end with a failure
    # status, not wait in the debugger until ctest's timeout.
    export WINEDLLOVERRIDES="mscoree,mshtml,winemenubuilder.exe,winedbg.exe="
    # No print server: the printer lives inside the prefix. Point libcups at
    # a socket that does not exist so that it never talks to a system cupsd.
    export CUPS_SERVER="$TAVO_WINE/no-cups.sock" CUPS_SERVERROOT="$TAVO_WINE/cups"
    if [ -s "$TAVO_WINE/display" ]; then
        export DISPLAY=":$(cat "$TAVO_WINE/display")"
    fi
}

tavo_pid_alive() { [ -s "$1" ] && kill -0 "$(cat "$1")" 2>/dev/null; }

# Wait, up to a deadline, for a condition given as a command.
tavo_wait_for() {
    local seconds=$1; shift
    local deadline=$((SECONDS + seconds))
    until "$@"; do
        [ $SECONDS -lt $deadline ] || return 1
        sleep 0.05
    done
}

tavo_start_display() {
    tavo_pid_alive "$TAVO_WINE/xvfb.pid" && return 0
    tavo_wine_say "starting a virtual display"
    rm -f "$TAVO_WINE/display"
    setsid Xvfb -displayfd 3 -screen 0 1280x1024x24 -nolisten tcp -noreset \
        3>"$TAVO_WINE/display" </dev/null >"$TAVO_WINE/log/xvfb.log" 2>&1 &
    echo $! >"$TAVO_WINE/xvfb.pid"
    if ! tavo_wait_for 20 test -s "$TAVO_WINE/display"; then
        tavo_wine_say "Xvfb did not start; see $TAVO_WINE/log/xvfb.log"
        return 1
    fi
    export DISPLAY=":$(cat "$TAVO_WINE/display")"
}

tavo_start_wineserver() {
    # A persistent server keeps program start-up fast. Starting one when one
    # already runs for this prefix is harmless: the second exits at once
    # (with status 2), so the status says nothing here.
    wineserver -p </dev/null >>"$TAVO_WINE/log/wineserver.log" 2>&1 || true
}

tavo_create_prefix() {
    [ -f "$WINEPREFIX/.tavo-ready" ] && return 0
    tavo_wine_say "creating the Wine prefix (first run only, a few seconds)"
    # The first process must not inherit our streams, or services.exe keeps
    # them open and whoever reads them waits forever.
    wineboot -i </dev/null >"$TAVO_WINE/log/wineboot.log" 2>&1
    # Unmanaged windows: with no window manager, managed windows make every
    # program wait for a withdrawn state that never comes.
    wine reg add 'HKCU\Software\Wine\X11 Driver' /v Managed /d N /f \
        </dev/null >>"$TAVO_WINE/log/wineboot.log" 2>&1
    touch "$WINEPREFIX/.tavo-ready"
}

tavo_windows_path() { echo "Z:$1" | tr / '\\'; }

tavo_add_printer() {
    [ -f "$WINEPREFIX/.tavo-printer" ] && return 0
    local setup="$TAVO_BUILD/bin/wine_printer_setup.exe" ppd="$TAVO_BUILD/bin/tavo-postscript.ppd"
    if [ ! -f "$setup" ] || [ ! -f "$ppd" ]; then
        tavo_wine_say "printer set-up program not built yet; no default printer"
        return 0
    fi
    tavo_wine_say "registering the default printer"
    if wine "$setup" "Tavo PostScript" "$(tavo_windows_path "$ppd")" \
        </dev/null >>"$TAVO_WINE/log/printer.log" 2>&1; then
        touch "$WINEPREFIX/.tavo-printer"
    else
        tavo_wine_say "printer registration failed; see $TAVO_WINE/log/printer.log"
        return 1
    fi
}

tavo_start_keeper() {
    tavo_pid_alive "$TAVO_WINE/keeper.pid" && return 0
    local keeper="$TAVO_BUILD/bin/wine_keeper.exe"
    [ -f "$keeper" ] || return 0
    local ready="$TAVO_WINE/keeper.ready"
    rm -f "$ready"
    setsid wine "$keeper" "$(tavo_windows_path "$ready")" </dev/null >"$TAVO_WINE/log/keeper.log" 2>&1 &
    echo $! >"$TAVO_WINE/keeper.pid"
    # The keeper must be the program that starts Wine's services (they keep
    # the streams of whoever starts them); wait until it is up.
    if ! tavo_wait_for 60 test -e "$ready"; then
        tavo_wine_say "the keeper program did not start; see $TAVO_WINE/log/keeper.log"
        return 1
    fi
}

# tavo_wine_up: make the environment ready; idempotent and cheap when it is.
tavo_wine_up() {
    mkdir -p "$XDG_CONFIG_HOME" "$XDG_CACHE_HOME" "$XDG_DATA_HOME" "$WINEPREFIX" \
        "$CUPS_SERVERROOT" "$TAVO_WINE/log"
    tavo_start_display &&
    tavo_start_wineserver &&
    tavo_create_prefix &&
    tavo_start_keeper &&
    tavo_add_printer
}

tavo_wine_down() {
    if [ -d "$WINEPREFIX" ]; then
        wineserver -k </dev/null >/dev/null 2>&1 || true
        # Wait until the server has really gone: a program started while it
        # is still exiting would start a new, non-persistent server of its own
        # that inherits the caller's streams and outlives it.
        wineserver -w </dev/null >/dev/null 2>&1 || true
    fi
    rm -f "$TAVO_WINE/keeper.pid"
    if tavo_pid_alive "$TAVO_WINE/xvfb.pid"; then
        kill "$(cat "$TAVO_WINE/xvfb.pid")" 2>/dev/null || true
    fi
    rm -f "$TAVO_WINE/xvfb.pid" "$TAVO_WINE/display"
}
