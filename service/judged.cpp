#include "service/judged.h"

#include <algorithm>
#include <limits>

namespace wp {
namespace {

int strength(const AccessPoint& accessPoint) {
    return accessPoint.signal.value_or(std::numeric_limits<int>::min());
}

Known<const AccessPoint*> joinedAccessPoint(const Facts& facts) {
    if (!facts.link) return facts.link.error();
    if (!facts.link->joined)
        return failure(Reason::notJoined, facts.link->interfaceName + " is not joined to a network");
    return &*facts.link->joined;
}

Known<const AccessPoint*> strongestNamed(const Facts& facts, const NetworkName& name) {
    if (!facts.nearby) return facts.nearby.error();
    const AccessPoint* strongest = nullptr;
    for (const AccessPoint& each : *facts.nearby) {
        if (each.directOnly || each.says.name != name) continue;
        if (strongest == nullptr || strength(each) > strength(*strongest)) strongest = &each;
    }
    if (strongest == nullptr) return failure(Reason::notFound, "the scan did not see a network of this name");
    return strongest;
}

}  // namespace

Known<const AccessPoint*> judgedAccessPoint(const Facts& facts) {
    return facts.named ? strongestNamed(facts, *facts.named) : joinedAccessPoint(facts);
}

Known<const AccessPoint*> judgedAsHeardLast(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged || !facts.nearby) return judged;
    // A scan that was kept may be older.
    for (const AccessPoint& each : *facts.nearby)
        if (each.joined && each.address == (*judged)->address && each.lastSeen >= (*judged)->lastSeen)
            return &each;
    return judged;
}

Known<std::vector<const AccessPoint*>> judgedNetwork(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    if (!facts.nearby) return facts.nearby.error();
    std::vector<const AccessPoint*> network{*judged};
    for (const AccessPoint& each : *facts.nearby) {
        const bool isOther = each.address != (*judged)->address && !each.directOnly;
        if (isOther && each.says.name == (*judged)->says.name) network.push_back(&each);
    }
    return network;
}

}  // namespace wp
