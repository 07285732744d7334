# shellcheck shell=bash
# Functions for the [during] part of a scenario: a terminal with the program in it. Sourced after lib.sh.

# on_a_terminal < script
on_a_terminal() {
    cat > /run/lab/on-terminal
    LC_ALL=C.UTF-8 tmux -u -f /dev/null -S /run/lab/tmux new-session -d -x 100 -y 20 'bash /run/lab/on-terminal'
}
picture() { tmux -u -S /run/lab/tmux capture-pane -p | sed 's/ *$//' | cat -s; }
# press KEY...: Up, Down, Enter, Escape, ...
press() { tmux -u -S /run/lab/tmux send-keys "$@"; }

# shows TEXT..., shows_no TEXT: waits until the picture holds all of the texts, or does not hold the text.
holds() { local text seen; seen=$(picture); for text in "$@"; do [[ $seen == *"$text"* ]] || return 1; done; }
holds_no() { ! holds "$1"; }
shows() { wait_for 60 holds "$@"; }
shows_no() { wait_for 60 holds_no "$@"; }

# screen_is < lines: waits until the picture is exactly these lines; else prints how it differs.
equals() { [ "$(picture)" = "$1" ]; }
screen_is() {
    local wanted; wanted=$(cat)
    wait_for 60 equals "$wanted" || { diff <(echo "$wanted") <(picture); return 1; }
}
