# Functions for scripts that run inside the lab: . "$LAB_DIR/lib.sh"
# Those that manage a device are in managers.sh.
# State of interface X is under /run/lab/X; an access point's radio lives in the
# network namespace ap-X, so that only the air joins it to the station.

phy_of() { cat "/sys/class/net/$1/phy80211/name"; }
in_ap() { local dev=$1; shift; ip netns exec "ap-$dev" "$@"; }

# wait_for SECONDS COMMAND...: until the command succeeds.
wait_for() {
    local end=$((SECONDS + $1)); shift
    until "$@" > /dev/null 2>&1; do [ $SECONDS -lt $end ] || return 1; sleep 0.1; done
}

# fresh_radios N [hwsim options]: N new radios, wlan0..., in a kernel that remembers no regulatory domain and no scan result.
# A radio comes back from a finished network namespace only a moment later.
no_radios() {
    [ -d /sys/module/mac80211_hwsim ] || return 0
    wait_for 10 modprobe -r mac80211_hwsim && wait_for 5 modprobe -r mac80211 cfg80211
}
fresh_radios() {
    local count=$1; shift
    no_radios || return 1
    [ "$count" = 0 ] && { modprobe cfg80211; return; }
    # Without that option hwsim's radios under Debian's kernel scan 6 GHz too, see README.
    [ "$LAB_BACK" = uml ] || set -- regtest=5 "$@"
    modprobe mac80211_hwsim radios="$count" "$@" && wait_for 5 test -e "/sys/class/net/wlan$((count - 1))"
}

# country CC: sets the regulatory domain and waits for it.
is_country() { iw reg get | grep -q "^country $1"; }
country() { iw reg set "$1"; wait_for 5 is_country "$1"; }

# ap X ADDRESS/24|- < hostapd.conf: starts hostapd on X (give neither interface
# nor driver) and, with an address, dnsmasq there: DHCP, and DNS answering that
# address for every name.
ap() {
    local dev=$1 addr=$2 dir=/run/lab/$1 ns=ap-$1
    mkdir -p "$dir"
    { echo "interface=$dev"; echo driver=nl80211; echo "ctrl_interface=$dir/ctl"; cat; } > "$dir/hostapd.conf"
    if ! ip netns list | grep -qw "$ns"; then
        ip netns add "$ns"; ip -n "$ns" link set lo up
        iw phy "$(phy_of "$dev")" set netns name "$ns"
    fi
    in_ap "$dev" hostapd -B -f "$dir/hostapd.log" -P "$dir/hostapd.pid" "$dir/hostapd.conf" > "$dir/hostapd.out" 2>&1 &&
        wait_for "${AP_WAIT:-10}" grep -q AP-ENABLED "$dir/hostapd.log" ||
        { echo "ap $dev did not start:"; cat "$dir/hostapd.out" "$dir/hostapd.log" | tail -n 8; return 1; }
    [ "$addr" = - ] && return
    ip -n "$ns" addr replace "$addr" dev "$dev"
    local net=${addr%.*}
    in_ap "$dev" dnsmasq --interface="$dev" --bind-interfaces --no-resolv --no-hosts --conf-file=/dev/null \
        --dhcp-range="$net.50,$net.99,1h" --dhcp-leasefile="$dir/leases" --address="/#/${addr%/*}" \
        --pid-file="$dir/dnsmasq.pid" --log-facility="$dir/dnsmasq.log" --log-dhcp --user=root
}

# ap_down X: stops what ap started; the radio stays in its namespace.
ap_down() {
    local f
    for f in dnsmasq hostapd; do
        [ ! -e "/run/lab/$1/$f.pid" ] || kill "$(cat "/run/lab/$1/$f.pid")" 2>/dev/null
    done
    wait_for 5 test ! -e "/run/lab/$1/hostapd.pid"; : > "/run/lab/$1/hostapd.log"
}

# ap_up_again X: after `rfkill block wifi`, which blocks every namespace's radios.
ap_up_again() { wait_for 5 ip -n "ap-$1" link set "$1" up; }

# sta X < network blocks: starts wpa_supplicant on X, and on the message bus where there is one. sta_up X waits for it to
# be associated and authorised; sta_down X stops it.
sta() {
    local dir=/run/lab/$1
    mkdir -p "$dir"
    { echo 'ctrl_interface=/run/wpa_supplicant'; cat; } > "$dir/wpa.conf"
    local bus=''; [ ! -S /run/dbus/system_bus_socket ] || bus=-u
    wpa_supplicant -B $bus -i "$1" -D nl80211 -c "$dir/wpa.conf" -f "$dir/wpa.log" -P "$dir/wpa.pid" > "$dir/wpa.out" 2>&1
}
sta_is_up() { wpa_cli -i "$1" status | grep -q wpa_state=COMPLETED; }
sta_up() { wait_for "${2:-20}" sta_is_up "$1"; }
sta_down() { wpa_cli -i "$1" terminate > /dev/null 2>&1; wait_for 5 test ! -e "/run/lab/$1/wpa.pid"; ip addr flush dev "$1"; }

# enterprise_files: the users and the certificate that an access point with WPA-EAP needs (user / secret).
enterprise_files() {
    mkdir -p /run/lab
    printf '%s\n' '"user" PEAP' '"user" MSCHAPV2 "secret" [2]' > /run/lab/users
    openssl req -x509 -newkey rsa:2048 -nodes -subj /CN=lab -days 3650 \
        -keyout /run/lab/key.pem -out /run/lab/ca.pem 2> /dev/null
}

# dhcp X: asks for an address once.
dhcp() {
    local dir=/run/lab/$1
    mkdir -p "$dir"
    cat > "$dir/udhcpc" <<'S'
#!/bin/sh
[ "$1" = bound ] || exit 0
ip addr replace "$ip/$mask" dev "$interface"
[ -z "$router" ] || ip route replace default via "$router" dev "$interface"
[ -z "$dns" ] || { rm -f /etc/resolv.conf; for d in $dns; do echo "nameserver $d"; done > /etc/resolv.conf; }
S
    chmod +x "$dir/udhcpc"
    busybox udhcpc -i "$1" -n -t 5 -s "$dir/udhcpc" > "$dir/udhcpc.log" 2>&1
}

# peer_link_is_up: whether a Wi-Fi Direct group of the station's own radio has a channel.
peer_link_is_up() { iw dev | grep -A9 'Interface p2p-wlan0' | grep -q channel; }

# scan X [iw scan arguments]: a fresh scan, retried while the radio is busy.
scan() {
    local dev=$1 i; shift
    ip link set "$dev" up
    for i in 1 2 3 4 5; do timeout 60 iw dev "$dev" scan "$@" 2>/dev/null && return; sleep 0.5; done
    return 1
}

# switch_of RADIO on|off: the power switch of one radio alone.
switch_of() {
    local switch; switch=$(echo "/sys/class/net/$1/phy80211"/rfkill*)
    rfkill "$([ "$2" = on ] && echo unblock || echo block)" "${switch##*rfkill}"
}

# signal X DBM: the strength (-1 to -100) at which access point X is heard by
# all: the simulated strength is rx_rssi, which takes only unsigned numbers, plus
# the transmit power, here set to 0.
signal() {
    local phy; phy=phy$(in_ap "$1" iw dev "$1" info | sed -n 's/.*wiphy //p')
    in_ap "$1" iw dev "$1" set txpower fixed 0
    printf '%u\n' "$2" > "/sys/kernel/debug/ieee80211/$phy/hwsim/rx_rssi"
}

# portal X: a captive portal on access point X: every name leads to it (see ap),
# and every page redirects to its login page. Needs python3.
portal() {
    local addr; addr=$(ip -n "ap-$1" -4 -o addr show dev "$1" | sed 's,.*inet \([0-9.]*\)/.*,\1,')
    in_ap "$1" python3 - "$addr" > "/run/lab/$1/portal.log" 2>&1 <<'P' &
import http.server, sys
host = sys.argv[1]
class Portal(http.server.BaseHTTPRequestHandler):
    def do_GET(self):
        login = self.path == '/login'
        self.send_response(200 if login else 302)
        if not login:
            self.send_header('Location', 'http://%s/login' % host)
        self.end_headers()
        self.wfile.write(b'<html>log in</html>' if login else b'')
http.server.ThreadingHTTPServer((host, 80), Portal).serve_forever()
P
    wait_for 10 in_ap "$1" busybox wget -q -O /dev/null "http://$addr/login"
}

# no_internet X: nothing lies beyond access point X; without it a scenario has an `internet` there.
no_internet() { :; }

# internet X [behaviours]: what the tests contact lies beyond access point X, see the head of `internet`; every name
# leads there (for an access point with an address). The program's configuration names it.
internet() {
    local dev=$1 there=203.0.113.10; shift
    in_ap "$dev" ip addr add $there/32 dev lo 2> /dev/null
    names_lead "$dev" $there
    # A home's one translation, unless the behaviours say something else.
    [ $# -gt 0 ] || set -- nat=203.0.113.77 mapped=203.0.113.77
    internet_at "$dev" $there 2001:db8:1::1 "$@"
}

# internet_over_ipv6 X ADDRESS [behaviours]: the same for an access point with an IPv6 address alone.
internet_over_ipv6() {
    local dev=$1 there=$2; shift 2
    in_ap "$dev" ip addr add "$there/128" dev lo nodad
    in_ap "$dev" dnsmasq --no-resolv --no-hosts --conf-file=/dev/null --address="/#/$there" --bind-dynamic \
        --pid-file="/run/lab/$dev/dnsmasq.pid" --user=root
    internet_at "$dev" 203.0.113.10 "$there" "$@"
}

# internet_at X IPV4 IPV6 [behaviours]
internet_at() {
    local dev=$1 there=$2 there6=$3 dir=/run/lab; shift 3
    [ -s $dir/internet.pem ] || openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:P-256 -nodes -subj /CN=lab -days 3650 \
        -addext 'subjectAltName=DNS:portal.example,DNS:vendor.example,DNS:api.example' \
        -keyout $dir/internet-key.pem -out $dir/internet.pem 2> /dev/null
    : > "$dir/$dev/internet.log"
    in_ap "$dev" "$LAB_DIR/internet" "$there" $dir/internet.pem $dir/internet-key.pem "$@" > "$dir/$dev/internet.log" 2>&1 &
    wait_for 20 grep -q ready "$dir/$dev/internet.log" || { cat "$dir/$dev/internet.log"; return 1; }
    mkdir -p /etc/wifi-profile
    cat > /etc/wifi-profile/config.json <<C
{"endpoints": {"pingIPv4": "$there", "pingIPv6": "$there6", "name": "host.example",
  "portalPlain": "http://portal.example/204", "portalSecure": "https://portal.example/204",
  "vendorHost": "vendor.example:443", "vendorUrl": "https://vendor.example/vendor", "stun": "$there:3478",
  "certificateAuthorities": "$dir/internet.pem"}}
C
}

# names_lead X ADDRESS: DNS on access point X answers that address for every name from now on.
names_lead() {
    local dir=/run/lab/$1
    kill "$(cat "$dir/dnsmasq.pid")"; wait_for 5 test ! -e "$dir/dnsmasq.pid"
    local net; net=$(ip -n "ap-$1" -4 -o addr show dev "$1" | sed 's,.*inet \([0-9.]*\)\.[0-9]*/.*,\1,')
    in_ap "$1" dnsmasq --interface="$1" --bind-interfaces --no-resolv --no-hosts --conf-file=/dev/null \
        --dhcp-range="$net.50,$net.99,1h" --dhcp-leasefile="$dir/leases" --address="/#/$2" \
        --pid-file="$dir/dnsmasq.pid" --log-facility="$dir/dnsmasq.log" --user=root "${@:3}"
}

# name_server X ADDRESS BEHAVIOURS...: a name server with faults on access point X, see the head of `name-server`; where
# names were asked for there before, it takes over.
name_server() {
    local dir=/run/lab/$1
    [ ! -e "$dir/dnsmasq.pid" ] || { kill "$(cat "$dir/dnsmasq.pid")"; wait_for 5 test ! -e "$dir/dnsmasq.pid"; }
    : > "$dir/name-server.log"
    in_ap "$1" "$LAB_DIR/name-server" "${@:2}" > "$dir/name-server.log" 2>&1 &
    wait_for 20 grep -q ready "$dir/name-server.log" || { cat "$dir/name-server.log"; return 1; }
}

# shellcheck disable=SC1091
. "$LAB_DIR/managers.sh"
