#pragma once

#include <deque>
#include <functional>
#include <vector>

#include "linux/netlink_socket.h"
#include "linux/radio_messages.h"

namespace wp {

/// What a scan is to look for.
struct ScanOrder {
    std::vector<NetworkName> names;          ///< to ask for by name
    bool probeForAll = true;                 ///< ask for networks of any name
    std::vector<std::uint32_t> frequencies;  ///< MHz; empty: all that the radio may use
    // With neither names nor `probeForAll` the scan only listens.
};

/// Puts the order's names, channels and flags into a request for a scan. *Any* thread.
void putOrder(NetlinkRequest& request, const ScanOrder& order);

/// Questions about radios to the kernel. One thread at a time; every question blocks until its answer or the end
/// of `until`. Asking needs no privilege; `startScan` needs CAP_NET_ADMIN.
class RadioSocket {
  public:
    /// An error where the kernel knows no Wi-Fi.
    static Known<RadioSocket> open(const Until& until);

    Known<std::vector<RadioInterface>> interfaces(const Until& until);
    Known<std::vector<AccessPoint>> accessPoints(std::uint32_t interfaceIndex, const Until& until);
    /// The access point that the interface is joined to, of several at once the strongest; nothing where it has not joined.
    Known<std::optional<AccessPoint>> joined(std::uint32_t interfaceIndex, const Until& until);
    /// The link to the access point of this address.
    Known<Station> station(std::uint32_t interfaceIndex, const MacAddress& accessPoint, const Until& until);
    Known<Survey> survey(std::uint32_t interfaceIndex, const Until& until);
    Known<Airtime> airtime(std::uint32_t interfaceIndex, const Until& until);
    Known<Regulation> regulation(std::uint32_t radio, const Until& until);
    Known<RadioAbilities> abilities(std::uint32_t radio, const Until& until);

    /// Starts a scan; 0 or an errno, `EBUSY` while another one runs. What was told of earlier scans is forgotten,
    /// so that the next event of the radio is this scan's, or, with `EBUSY`, the running one's.
    int startScan(std::uint32_t interfaceIndex, const ScanOrder& order, const Until& until);
    /// Ends a scan that was started here.
    void abortScan(std::uint32_t interfaceIndex);

    /// Also receives what becomes of scans, from now on.
    bool listenForScans();
    /// The start of a scan of this interface, once `listenForScans` has succeeded; what came before it is forgotten.
    Known<ScanEvent> nextScanStart(std::uint32_t interfaceIndex, const Until& until);
    /// The end of a scan of this interface.
    Known<ScanEvent> nextScanEnd(std::uint32_t interfaceIndex, const Until& until);
    /// The end of a scan of any interface of the radio: as long as one of them scans, no other may.
    Known<ScanEvent> nextScanEndOfRadio(std::uint32_t radio, const Until& until);

  private:
    RadioSocket(NetlinkSocket questions, RadioFamily family);

    NetlinkAnswer ask(std::uint8_t command, std::uint16_t flags, std::uint32_t interfaceIndex,
                      const Until& until);
    Known<ScanEvent> nextScanEvent(const std::function<bool(const ScanEvent&)>& isWanted, const Until& until);
    void receiveWaitingEvents();
    void forgetEventsBeforeTheLatestStart(std::uint32_t interfaceIndex);
    NetlinkAnswer askAboutRadio(std::uint8_t command, std::uint32_t radio, const Until& until);

    NetlinkSocket questions_;
    std::optional<NetlinkSocket> events_;  ///< only where somebody listens
    RadioFamily family_;
    std::deque<ScanEvent> arrived_;
};

/// The reason behind an errno that a question about `what` ended with.
Error failureOf(int error, const std::string& what);

/// ms on the clock that counts suspended time too.
std::int64_t bootMilliseconds();

}  // namespace wp
