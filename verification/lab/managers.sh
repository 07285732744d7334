# shellcheck shell=bash
# Functions of lib.sh that start what manages a device: message bus, connection managers, resolver, DHCP clients, Bluetooth.
# Programs whose packages would take over the host's own network are unpacked under $LAB_PROGRAMS, see setup.

# message_bus: the system's bus; everybody may own every name on it.
message_bus() {
    [ ! -S /run/dbus/system_bus_socket ] || return 0
    mkdir -p /run/dbus /run/lab
    printf '%s\n' '<busconfig><type>system</type><listen>unix:path=/run/dbus/system_bus_socket</listen>' \
        '<auth>EXTERNAL</auth><policy context="default"><allow send_destination="*"/><allow receive_type="method_call"/><allow receive_type="method_return"/>' \
        '<allow receive_type="error"/><allow receive_type="signal"/><allow send_requested_reply="true"/>' \
        '<allow own="*"/><allow user="*"/></policy></busconfig>' > /run/lab/bus.conf
    [ -s /etc/machine-id ] || dbus-uuidgen > /etc/machine-id
    dbus-daemon --config-file=/run/lab/bus.conf --fork
}
# on_bus NAME: whether somebody has the name.
on_bus() { dbus-send --system --print-reply --dest=org.freedesktop.DBus / org.freedesktop.DBus.GetNameOwner string:"$1"; }
# without_udev COMMAND...: a manager does without the device daemon, which is not here, where /sys is read-only.
without_udev() { unshare -m sh -c 'mount -o remount,bind,ro /sys; exec "$@"' sh "$@"; }

# network_manager X: NetworkManager, and the wpa_supplicant that it drives, for interface X only.
nm_ready() { nmcli -t -f STATE general | grep -qv '^unknown' && nmcli -t -f DEVICE,STATE device | grep -q "^$1:\(disconnected\|conn\)"; }
network_manager() {
    mkdir -p /etc/NetworkManager/conf.d
    message_bus
    printf '%s\n' '[main]' 'plugins=keyfile' 'dhcp=internal' 'auth-polkit=false' 'rc-manager=file' \
        '[keyfile]' "unmanaged-devices=*,except:interface-name:$1" \
        '[connectivity]' 'enabled=false' > /etc/NetworkManager/NetworkManager.conf
    wpa_supplicant -B -u -f /run/lab/wpa-dbus.log > /dev/null
    without_udev NetworkManager --log-level=INFO > /run/lab/nm.log 2>&1
    wait_for 20 nm_ready "$1" || { tail -n 20 /run/lab/nm.log; return 1; }
}

# networkd X < .network file without [Match]: systemd-networkd for interface X, which something else has joined; waits for
# its addresses.
networkd() {
    message_bus
    mkdir -p /run/systemd/network /run/systemd/netif/{links,leases,lldp}
    chown -R systemd-network /run/systemd/netif
    { printf '%s\n' '[Match]' "Name=$1" ''; cat; } > "/run/systemd/network/$1.network"
    without_udev /lib/systemd/systemd-networkd > /run/lab/networkd.log 2>&1 &
    timeout 60 /lib/systemd/systemd-networkd-wait-online -4 -i "$1" > /run/lab/networkd-wait.log 2>&1 ||
        { cat /run/lab/networkd.log /run/lab/networkd-wait.log; networkctl status "$1"; return 1; }
}

# resolved: systemd-resolved, and its stub in the resolver's file.
resolved() {
    message_bus
    grep -q ^systemd-resolve: /etc/passwd || echo 'systemd-resolve:x:985:985::/:/usr/sbin/nologin' >> /etc/passwd
    grep -q ^systemd-resolve: /etc/group || echo 'systemd-resolve:x:985:' >> /etc/group
    mkdir -p /run/systemd/resolve; chown systemd-resolve:systemd-resolve /run/systemd/resolve
    # It keeps what it once read of a file that is not its own.
    ln -sf /run/systemd/resolve/stub-resolv.conf /etc/resolv.conf
    "$LAB_PROGRAMS/lib/systemd/systemd-resolved" > /run/lab/resolved.log 2>&1 &
    wait_for 20 test -e /run/systemd/resolve/stub-resolv.conf && wait_for 20 on_bus org.freedesktop.resolve1 ||
        { cat /run/lab/resolved.log; return 1; }
}

# iwd X: iwd, which joins by itself what stands in /var/lib/iwd and then asks for an address; waits until it is connected.
iwd_joined() { "$LAB_PROGRAMS/usr/bin/iwctl" station "$1" show | grep -q 'State *connected'; }
iwd() {
    message_bus
    mkdir -p /etc/iwd
    printf '%s\n' '[General]' EnableNetworkConfiguration=true '[Network]' NameResolvingService=none > /etc/iwd/main.conf
    "$LAB_PROGRAMS/usr/libexec/iwd" -i "$1" > /run/lab/iwd.log 2>&1 &
    wait_for 60 iwd_joined "$1" || { cat /run/lab/iwd.log; return 1; }
}

# connman X < settings of a network: ConnMan, and the wpa_supplicant that it drives, for interface X only; waits until it is connected.
connman_connected() { "$LAB_PROGRAMS/usr/bin/connmanctl" services | grep -q '^..[OR] '; }
connman() {
    message_bus
    mkdir -p /var/lib/connman /run/connman /etc/connman
    printf '%s\n' '[General]' EnableOnlineCheck=false AllowHostnameUpdates=false > /etc/connman/main.conf
    printf '%s\n' '[global]' OfflineMode=false '[WiFi]' Enable=true > /var/lib/connman/settings
    ln -sf /run/connman/resolv.conf /etc/resolv.conf
    { printf '%s\n' '[service_of_the_lab]' Type=wifi; cat; } > /var/lib/connman/lab.config
    wpa_supplicant -B -u -f /run/lab/wpa-dbus.log > /dev/null
    "$LAB_PROGRAMS/usr/sbin/connmand" -n -i "$1" -c /etc/connman/main.conf > /run/lab/connman.log 2>&1 &
    wait_for 60 connman_connected || { "$LAB_PROGRAMS/usr/bin/connmanctl" services; cat /run/lab/connman.log; return 1; }
}

# ifupdown WORD < /etc/network/interfaces: starts an interface as ifup is told to by that word, as "wlan0" or "wlan0=home".
ifupdown() {
    mkdir -p /etc/network /run/network /run/lab
    cat > /etc/network/interfaces
    "$LAB_PROGRAMS/sbin/ifup" --no-scripts "$1" > /run/lab/ifup.log 2>&1 || { cat /run/lab/ifup.log; return 1; }
}

# dhclient_lease X: an address from ISC's client, which keeps the lease, and asks for a portal's API and vendor's text too.
dhclient_lease() {
    printf '%s\n' 'request subnet-mask, routers, domain-name-servers, default-url, vendor-encapsulated-options;' \
        > "/run/lab/$1/dhclient.conf"
    dhclient -1 -cf "/run/lab/$1/dhclient.conf" -lf "/var/lib/dhcp/dhclient.$1.leases" -pf "/run/lab/$1/dhclient.pid" "$1" \
        > "/run/lab/$1/dhclient.log" 2>&1 || { cat "/run/lab/$1/dhclient.log"; return 1; }
}

# dhclient_lease6 X: the same of DHCPv6, once the router has said that there is some.
dhclient_lease6() {
    echo 'also request dhcp6.v6-captive-portal;' > "/run/lab/$1/dhclient6.conf"
    dhclient -6 -1 -cf "/run/lab/$1/dhclient6.conf" -lf "/var/lib/dhcp/dhclient6.$1.leases" -pf "/run/lab/$1/dhclient6.pid" "$1" \
        > "/run/lab/$1/dhclient6.log" 2>&1 || { cat "/run/lab/$1/dhclient6.log"; return 1; }
}

# dhcpcd_lease X [SETTING...]: addresses from dhcpcd, which keeps the servers' answers byte for byte; or from its settings.
dhcpcd_lease() {
    local dir=/run/lab/$1
    printf '%s\n' '#!/bin/sh' 'set -- $new_domain_name_servers $new_dhcp6_name_servers; [ $# = 0 ] || printf "nameserver %s\n" "$@" > /etc/resolv.conf' \
        > "$dir/dhcpcd-hook"
    chmod +x "$dir/dhcpcd-hook"
    printf '%s\n' 'option domain_name_servers, routers' 'option dhcp6_name_servers' "${@:2}" > /etc/dhcpcd.conf
    mkdir -p /var/lib/dhcpcd
    grep -q ^dhcpcd: /etc/passwd || echo 'dhcpcd:x:984:984::/var/lib/dhcpcd:/usr/sbin/nologin' >> /etc/passwd
    "$LAB_PROGRAMS/usr/sbin/dhcpcd" -f /etc/dhcpcd.conf -c "$dir/dhcpcd-hook" -w -t 30 "$1" > "$dir/dhcpcd.log" 2>&1 ||
        { cat "$dir/dhcpcd.log"; return 1; }
}

# local_resolver [OPTION...]: dnsmasq in the resolver's file, as its package has it together with resolvconf: what the file named
# before is in a file of dnsmasq's own.
local_resolver() {
    mkdir -p /run/dnsmasq
    cp /etc/resolv.conf /run/dnsmasq/resolv.conf
    dnsmasq --conf-file=/dev/null -r /run/dnsmasq/resolv.conf --listen-address=127.0.0.1 --bind-interfaces --user=root \
        --pid-file=/run/dnsmasq/dnsmasq.pid "$@"
    rm -f /etc/resolv.conf; echo nameserver 127.0.0.1 > /etc/resolv.conf
}

# bluetooth PAIRED CONNECTED [COMMAND]: a Bluetooth service with so many devices, that runs the command when it is asked.
bluetooth() {
    message_bus
    "$LAB_DIR/bluetooth" "$@" > /run/lab/bluetooth.log 2>&1 &
    wait_for 60 grep -q ready /run/lab/bluetooth.log || { cat /run/lab/bluetooth.log; return 1; }
}

# bluetooth_controller: a controller in the kernel, without a service that speaks for it.
bluetooth_controller() {
    modprobe hci_vhci && wait_for 5 test -e /dev/vhci
    { printf '\377\000' >&9; sleep infinity; } 9<> /dev/vhci &
    wait_for 5 test -e /sys/class/bluetooth/hci0
}

# pretend_driver X DRIVER [PARAMETER=VALUE]: files in place of /sys that say that X is driven by DRIVER, whose module has
# that parameter. All else there is the kernel's own. No simulated radio has a driver that shares its antenna.
pretend_driver() {
    local real=/run/lab/real-sys each
    mkdir -p $real; mount --bind /sys $real; mount -t tmpfs sys /sys
    for each in $real/*; do ln -s "$each" /sys/; done
    rm /sys/class /sys/module
    mkdir -p "/sys/class/net/$1/device" "/sys/module/$2/parameters"
    for each in $real/module/*; do ln -s "$each" /sys/module/; done
    for each in $real/class/*; do [ "$each" = $real/class/net ] || ln -s "$each" /sys/class/; done
    for each in $real/class/net/*; do [ "${each##*/}" = "$1" ] || ln -s "$each" /sys/class/net/; done
    for each in "$real/class/net/$1"/*; do [ "${each##*/}" = device ] || ln -s "$each" "/sys/class/net/$1/"; done
    ln -s "/sys/bus/pci/drivers/$2" "/sys/class/net/$1/device/driver"
    [ -z "${3:-}" ] || echo "${3#*=}" > "/sys/module/$2/parameters/${3%%=*}"
}
