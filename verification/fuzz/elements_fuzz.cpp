#include <cstdlib>

#include "service/access_point.h"
#include "service/catalogue.h"

using namespace wp;

namespace {

/// Any name comes back from its text.
void checkName(const NetworkName& name) {
    if (nameFromText(textFromName(name)) != name) std::abort();
}

/// Whatever the elements hold, each test has a finding or an error with a code.
void checkVerdicts(const AccessPoint& accessPoint) {
    Facts facts;
    facts.link = Link{"wlan0", 3, 0, true, accessPoint};
    facts.nearby = std::vector<AccessPoint>{accessPoint};
    facts.listened = facts.nearby;
    for (const NumberedTest& test : numberedTests()) {
        const Outcome outcome = judge(test, facts);
        if (!outcome && outcome.error().code == 0) std::abort();
    }
}

}  // namespace

/// Two bytes of capability, one that says where the latest frame ends and the beacon begins, then both.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size < 3) return 0;
    const Bytes frames(data + 3, size - 3);
    const std::size_t cut = frames.size() * data[2] / 255;
    AccessPoint accessPoint;
    accessPoint.frequency = size % 2 != 0 ? 2412 : 5180;
    accessPoint.capability = littleEndian16({data, 2}, 0);
    accessPoint.says = decodeAdvertised(accessPoint.capability, frames.first(cut), frames.subspan(cut));
    checkName(accessPoint.says.name);
    checkVerdicts(accessPoint);
    phyModesOf(accessPoint);
    return 0;
}
