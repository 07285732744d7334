# Joined to an old router far away: first WPA, a factory name, rare beacons, a sign-in page, two translations, a gateway
# that does not answer, 802.11b only. A loud neighbour stands on the same channel.
. "$LAB_DIR/lib.sh"; . "$LAB_DIR/demos/air.sh"
country US
ap wlan1 10.0.0.1/24 <<< "ssid=linksys
country_code=US
ieee80211d=1
hw_mode=b
channel=6
beacon_int=300
dtim_period=5
wpa=1
wpa_key_mgmt=WPA-PSK
wpa_pairwise=TKIP
wpa_passphrase=correct horse"
signal wlan1 -80
internet wlan1 redirect no-https nat=192.168.0.2
in_ap wlan1 nft 'add table inet t; add chain inet t c { type filter hook input priority 0; }; add rule inet t c icmp type echo-request drop'
wpa2 wlan2 'Upstairs 24' -45 "$(G 6)
ht_capab=[HT40+]"
open wlan3 'Cafe Guest' -58 "$(G 6)"
joined 'linksys' 'correct horse'
recorded 'linksys' 'Upstairs 24' 'Cafe Guest'
