# One program on a virtual display: sourced by scripts in bash that look at it while it runs.

display_folder="" display_server="" running=""

start_display() {
    display_folder=$(mktemp -d)
    trap end_display EXIT
    Xvfb -displayfd 3 -screen 0 1280x900x24 -nolisten tcp -noreset 3>"$display_folder/number" 2>/dev/null &
    display_server=$!
    for _ in $(seq 100); do
        [ -s "$display_folder/number" ] && break
        sleep 0.1
    done
    DISPLAY=:$(cat "$display_folder/number")
    export DISPLAY
}

end_display() {
    end_program || true
    [ -z "$display_server" ] || kill "$display_server" 2>/dev/null || true
    rm -rf "$display_folder"
}

# start_program PROGRAM [ARGUMENT...]: no shell function, so that $running is the program itself.
start_program() {
    "$@" &
    running=$!
}

# Sets $window. The splash has the same title; the main window is the wide one.
await_main_window() {
    local width
    for _ in $(seq 200); do
        for window in $(xdotool search --onlyvisible --name "Dr. Orvanta" 2>/dev/null); do
            width=$(xdotool getwindowgeometry --shell "$window" 2>/dev/null | sed -n 's/^WIDTH=//p')
            [ "${width:-0}" -lt 900 ] || return 0
        done
        kill -0 "$running" 2>/dev/null || { echo "The program ended early."; return 1; }
        sleep 0.1
    done
    echo "No main window came up."
    return 1
}

take_picture() { # FILE
    sleep 1
    import -window root "$1"
}

# Closes the program in the orderly way; its exit status.
end_program() {
    local program=$running
    running=""
    [ -n "$program" ] || return 0
    kill "$program" 2>/dev/null || true
    wait "$program"
}
