#include "service/reachability.h"

#include <algorithm>

namespace wp {
namespace {

bool leadsOutside(const IPAddress& address) {
    return !address.unspecified() && !address.loopback() && !address.linkLocal() && !address.privateUse();
}

bool clockSpoilsIt(const ServiceContact& contact, const ClockCheck& clock) {
    return contact.end == ServiceContact::End::badCertificate && clock.beforeBuild;
}

Error clockWrong() {
    return failure(Reason::badConfiguration, "clock wrong: certificates cannot be judged before it is set");
}

}  // namespace

std::vector<IPAddress> placesOf(const NameAnswer& answer) {
    std::vector<IPAddress> places = answer.addresses;
    std::erase_if(places, [](const IPAddress& each) { return each.unspecified() || each.loopback(); });
    return places;
}

std::string whyNowhere(const NameAnswer& answer) {
    if (answer.addresses.empty()) return "the name " + answer.name + " has no address: " + answer.why;
    return "the name servers lead " + answer.name + " nowhere, to " + answer.addresses.front().text();
}

Outcome resolvesNames(const Known<NameAnswer>& answer) {
    if (!answer) return answer.error();
    return works(std::any_of(answer->addresses.begin(), answer->addresses.end(), leadsOutside));
}

Outcome reachesVendor(const Known<ServiceContact>& contact, const ClockCheck& clock) {
    if (!contact) return contact.error();
    if (clockSpoilsIt(*contact, clock)) return clockWrong();
    return works(contact->end == ServiceContact::End::reached);
}

Outcome retrievesFromVendor(const Known<ServiceContact>& contact, const ExpectedContent& expected,
                            const ClockCheck& clock) {
    if (!contact) return contact.error();
    if (clockSpoilsIt(*contact, clock)) return clockWrong();
    const bool unaltered = contact->status == 200 && !expected.bodyPrefix.empty() &&
                           contact->body.starts_with(expected.bodyPrefix);
    return works(contact->end == ServiceContact::End::reached && (contact->status == 204 || unaltered));
}

}  // namespace wp
