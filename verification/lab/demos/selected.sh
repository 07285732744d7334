# Joined to a good network; a second one, Granary, is the one that gives trouble.
. "$LAB_DIR/lib.sh"; . "$LAB_DIR/demos/air.sh"
country US
wpa2 wlan1 'Northlight' -52 "$AC80" 10.0.0.1/24
ip -n ap-wlan1 addr add 2001:db8:1::1/64 dev wlan1
internet wlan1
ap wlan2 - <<< "ssid=Granary
country_code=US
ieee80211d=1
$(G 11)
beacon_int=200
wpa=3
wpa_key_mgmt=WPA-PSK
wpa_pairwise=TKIP
rsn_pairwise=CCMP
wpa_passphrase=correct horse"
signal wlan2 -81
wpa2 wlan3 'Maison Lavande' -70 "$(G 1)"
joined 'Northlight' 'correct horse'
recorded 'Northlight' 'Granary' 'Maison Lavande'
