# Joined to a good network with a name of its own; three quiet neighbours.
. "$LAB_DIR/lib.sh"; . "$LAB_DIR/demos/air.sh"
country US
wpa2 wlan1 'Northlight' -52 "$AC80" 10.0.0.1/24
ip -n ap-wlan1 addr add 2001:db8:1::1/64 dev wlan1
internet wlan1
ap wlan2 - <<< "ssid=Blue Kite
country_code=US
ieee80211d=1
$(G 1)
dtim_period=2
wmm_enabled=1
ieee80211n=1
wpa=2
wpa_key_mgmt=SAE
rsn_pairwise=CCMP
ieee80211w=2
wpa_passphrase=correct horse"
signal wlan2 -68
wpa2 wlan3 'Maison Lavande' -74 "$(G 11)"
open wlan4 'Café am Eck' -79 "$(G 6)"
joined 'Northlight' 'correct horse'
recorded 'Northlight' 'Blue Kite' 'Maison Lavande' 'Café am Eck'
