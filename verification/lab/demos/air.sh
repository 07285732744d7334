# Access points of the demo recordings, for scripts inside the lab: . air.sh

# wpa2 X 'SSID' SIGNAL 'more hostapd lines' [ADDRESS/24]: an access point secured with WPA2, which tells its maker by WPS.
wpa2() {
    ap "$1" "${5:--}" <<< "ssid=$2
country_code=US
ieee80211d=1
dtim_period=2
wmm_enabled=1
ieee80211n=1
wpa=2
wpa_key_mgmt=WPA-PSK
rsn_pairwise=CCMP
wpa_passphrase=correct horse
eap_server=1
wps_state=2
manufacturer=Fernleigh Networks
model_name=FN-20
device_name=Router
$4" && signal "$1" "$3"
}
# open X 'SSID' SIGNAL 'more hostapd lines' [ADDRESS/24]: an access point without security.
open() {
    ap "$1" "${5:--}" <<< "ssid=$2
country_code=US
ieee80211d=1
wmm_enabled=1
ieee80211n=1
$4" && signal "$1" "$3"
}
# joined 'SSID' 'PASSWORD': the station joins by way of NetworkManager, with an address of each family.
listed() { nmcli -t -f SSID device wifi list --rescan yes | grep -qx "$1"; }
joined() {
    network_manager wlan0 && wait_for 60 listed "$1" && nmcli -w 60 device wifi connect "$1" password "$2" &&
        ip addr add 2001:db8:1::7/64 dev wlan0 nodad
}
# recorded NAME...: what the program is told of the list and of each network, into $DEMO_OUT.
recorded() {
    local name number=0
    "$PROGRAM" run --list --max-scan-cache-age 0 --screen headless --remote 'wait back' --record "$DEMO_OUT/list.json"
    for name; do
        number=$((number + 1))
        "$PROGRAM" run --max-scan-cache-age 0 --network "$name" --record "$DEMO_OUT/network-$number.json" > /dev/null
    done
    true
}
AC80='hw_mode=a
channel=36
ieee80211ac=1
ht_capab=[HT40+]
vht_oper_chwidth=1
vht_oper_centr_freq_seg0_idx=42'
G() { printf 'hw_mode=g\nchannel=%s\n' "$1"; }
