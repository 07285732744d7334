#include "host/report/causes.h"

#include <algorithm>
#include <initializer_list>

namespace wp::host {
namespace {

/// What the causes are judged by.
struct View {
    const Evidence& evidence;
    const Checks& checks;

    bool yes(int testID) const { return checks.yes(testID); }
    bool no(int testID) const { return checks.no(testID); }
    /// Whether anything beyond the router was seen to work.
    bool reachesOutside() const { return yes(6) || yes(9) || yes(11); }
    bool isJoined() const { return wasTested(evidence, Part::joined); }
};

struct CauseRow {
    Cause cause;
    bool (*holds)(const View&);
};

bool endedWith(const View& view, std::int64_t statusCode) {
    return view.evidence.statusCode == statusCode;
}

/// After a selected network that opted out, a result alone does not tell whether one was joined.
bool hasNoJoined(const View& view) {
    std::int64_t code = view.evidence.statusCode;
    bool isTold = code == 0 || (code == -7 && view.evidence.hasAnswers);
    return isTold && !view.isJoined() && !view.evidence.joinedName;
}

/// A result alone holds the same for a device that did not tell.
bool isNotJoined(const View& view) {
    return hasNoJoined(view) && !view.evidence.isStatusUntold;
}

bool isJoinedUntold(const View& view) {
    return hasNoJoined(view) && view.evidence.isStatusUntold;
}

bool hasNoAddress(const View& view) {
    return view.no(12) && !view.yes(13);
}

bool isDead(const View& view) {
    return view.no(3) && !view.yes(7) && !view.reachesOutside() && (view.no(6) || view.no(7) || view.no(9));
}

/// A certificate that does not hold came from beyond the router all the same.
bool hasBadCertificate(const View& view) {
    return view.no(9) && textIn(detailsOf(view.evidence, Part::joined, 9), "end") == "badCertificate";
}

bool hasNoInternet(const View& view) {
    bool isSilent = view.no(6) && !view.no(3) && !view.yes(9) && !view.yes(11);
    return isSilent && (!view.yes(7) || view.no(9)) && !hasBadCertificate(view);
}

/// A certificate is told to be out of its time on a device whose clock is off by more than a day.
bool isOutOfTimeByClock(const DictionaryPointer& details) {
    constexpr double kDay = 86400;  // in seconds
    std::optional<std::string> fault = textIn(details, "certificateFault");
    double offset = numberIn(details, "clockOffset").value_or(0);
    return (fault == "notYetValid" || fault == "expired") && (offset > kDay || offset < -kDay);
}

/// Where the clock is before the program's own day the service tells it as an error of two tests, since it says
/// nothing about the network.
bool isClockWrong(const View& view) {
    for (int testID : {9, 11}) {
        const Answer* answer = answerTo(view.evidence, Part::joined, testID);
        if (answer && answer->error && answer->error->message.starts_with("clock wrong")) return true;
        if (isOutOfTimeByClock(detailsOf(view.evidence, Part::joined, testID))) return true;
    }
    return false;
}

bool isPartial(const View& view) {
    return textIn(detailsOf(view.evidence, Part::joined, 46), "connectivity") == "partial";
}

bool isTranslatedByProvider(const View& view) {
    std::optional<std::string> basis = textIn(detailsOf(view.evidence, Part::joined, 8), "judgedBy");
    return view.yes(8) && (basis == "routerShared" || basis == "sharedHop");
}

/// The service's codes of errors.
constexpr int kNoInterface = 1, kNotJoined = 2, kNotFound = 3;

bool failedWith(const View& view, Part part, int code, std::initializer_list<int> tests) {
    return std::ranges::all_of(tests, [&](int testID) {
        const Answer* answer = answerTo(view.evidence, part, testID);
        return answer && answer->error && answer->error->code == code;
    });
}

bool hasNoInterface(const View& view) {
    return endedWith(view, -3) || failedWith(view, Part::device, kNoInterface, {14, 15, 16});
}

/// The network was there when the run began, and gone when its tests came. A result alone then holds what a scan
/// tells of the surroundings and nothing of the network.
bool isLost(const View& view) {
    if (view.evidence.hasAnswers) return failedWith(view, Part::joined, kNotJoined, {34, 38, 12});
    bool isUnderway = view.evidence.statusCode == 0 && view.isJoined() && !view.evidence.joinedName;
    return isUnderway && std::ranges::none_of(std::initializer_list<int>{34, 38, 12, 9, 31}, [&](int testID) {
               return view.yes(testID) || view.no(testID);
           });
}

/// None of the first tests of the selected network found it in the scan.
bool isNotSeen(const View& view) {
    return failedWith(view, Part::selected, kNotFound, {34, 38, 43});
}

bool isWhereBandIsFull(const View& view, int lowest, int highest) {
    std::optional<double> channel = numberIn(view.evidence.joined, "currentChannel");
    return view.yes(24) && channel && *channel >= lowest && *channel <= highest;
}

constexpr int kHighest2GHzChannel = 14, kHighestChannel = 255;

using enum Part;
using enum Severity;
using enum Doer;

// clang-format off
/// Why nothing works: the first row that holds.
const CauseRow kOutages[] = {
    {{"NO_CLIENT",      "NO_CLIENT_WHOLE",      0, device, broken, viewer, {}}, [](const View& v) { return endedWith(v, -2); }},
    {{"NO_DEVICE",      "NO_DEVICE_WHOLE",      0, device, broken, viewer, {14, 15, 16, 17, 22, 20, 47, 48, 29}}, hasNoInterface},
    {{"POWER_DECLINED", "POWER_DECLINED_WHOLE", 0, device, broken, viewer, {}}, [](const View& v) { return endedWith(v, -4); }},
    {{"POWER_OFF",      "POWER_OFF_WHOLE",      0, device, broken, viewer, {}}, [](const View& v) { return endedWith(v, -5); }},
    {{"T31", "NO_NETWORKS_WHOLE", 31, joined, broken, viewer, {}}, [](const View& v) { return v.no(31) && !v.isJoined(); }},
    {{"NOT_JOINED", "NOT_JOINED_WHOLE",  0, device, broken, viewer, {}}, isNotJoined},
    {{"JOINED_UNTOLD", "JOINED_UNTOLD_WHOLE", 0, device, broken, viewer, {}}, isJoinedUntold},
    {{"LOST", "LOST_WHOLE", 34, joined, broken, viewer,
      {8, 35, 38, 39, 40, 41, 42, 43, 44, 46, 45, 36, 37, 33, 3, 6, 12, 13, 7, 9, 11, 24, 25, 26, 27, 28, 32, 30}}, isLost},
    {{"NO_ADDRESS", "NO_ADDRESS_WHOLE", 12, joined, broken, routerOwner, {13, 3, 6, 7, 9, 11, 46, 8}}, hasNoAddress},
    {{"T46",        "PORTAL_WHOLE",     46, joined, broken, viewer, {6, 7, 9, 11}},
     [](const View& v) { return v.yes(46); }},
    {{"DEAD_LINK",   "DEAD_LINK_WHOLE",    3, joined, broken, routerOwner, {6, 7, 9, 11, 46, 8}}, isDead},
    {{"NO_INTERNET", "NO_INTERNET_WHOLE",  6, joined, broken, provider, {7, 9, 11, 46, 8}}, hasNoInternet},
    {{"T7",          "NO_NAMES_WHOLE",     7, joined, broken, routerOwner, {9, 11, 46}}, [](const View& v) { return v.no(7); }},
    {{"CLOCK_WRONG", "CLOCK_WRONG_WHOLE",  9, joined, broken, viewer, {11}}, isClockWrong},
    {{"BAD_CERTIFICATE", "BAD_CERTIFICATE_WHOLE", 9, joined, broken, routerOwner, {11}}, hasBadCertificate},
    {{"T9",          "NO_SERVICE_WHOLE",   9, joined, problem, routerOwner, {11}},
     [](const View& v) { return v.no(9) && (v.yes(6) || v.yes(7)); }},
};

/// What may hold beside.
const CauseRow kOthers[] = {
    {{"PARTIAL", nullptr, 46, joined, problem, routerOwner, {}}, isPartial},
    {{"ROUTER_SILENT", nullptr, 3, joined, notice, nobody, {}},
     [](const View& v) { return v.no(3) && (v.yes(7) || v.reachesOutside()); }},
    {{"OUTSIDE_SILENT", nullptr, 6, joined, notice, nobody, {}},
     [](const View& v) { return v.no(6) && (v.yes(9) || v.yes(11) || hasBadCertificate(v)); }},
    {{"T12", nullptr, 12, joined, notice, nobody, {}}, [](const View& v) { return v.no(12) && v.yes(13) && (v.yes(7) || v.reachesOutside()); }},
    {{"T25", nullptr, 25, joined, problem, routerOwner, {24}},
     [](const View& v) { return v.yes(25) && isWhereBandIsFull(v, 1, kHighest2GHzChannel); }},
    {{"T26", nullptr, 26, joined, problem, routerOwner, {24}},
     [](const View& v) { return v.yes(26) && isWhereBandIsFull(v, kHighest2GHzChannel + 1, kHighestChannel); }},
    {{"NOT_SEEN", nullptr, 34, selected, problem, viewer, {38, 39, 40, 41, 42, 43, 44, 46, 45, 36, 37, 33, 24, 28, 32}}, isNotSeen},
    {{"REMEMBERED_PORTAL", nullptr, 46, selected, notice, viewer, {}}, [](const View& v) { return v.checks.yes(46, selected); }},
    {{"CARRIER", nullptr, 8, joined, advice, provider, {}}, isTranslatedByProvider},
    {{"T38", nullptr, 38, joined, advice, routerOwner, {}},
     [](const View& v) { return v.yes(38) && (v.yes(44) || v.yes(45) || v.yes(46)); }},
    {{"T20", nullptr, 20, device, advice, viewer, {19}},
     [](const View& v) { return v.checks.yes(20, device) && v.checks.yes(19, device); }},
};
// clang-format on

}  // namespace

std::vector<Cause> causesOf(const Evidence& evidence, const Checks& checks) {
    const View view{evidence, checks};
    std::vector<Cause> causes;
    for (const CauseRow& row : kOutages) {
        if (!row.holds(view)) continue;
        causes.push_back(row.cause);
        break;
    }
    for (const CauseRow& row : kOthers) {
        bool isExplained = false;
        for (const Cause& cause : causes) {
            bool leads = cause.testID == row.cause.testID;
            for (int testID : cause.follow) leads = leads || testID == row.cause.testID;
            isExplained = isExplained || (cause.part == row.cause.part && leads);
        }
        if (!isExplained && row.holds(view)) causes.push_back(row.cause);
    }
    return causes;
}

}  // namespace wp::host
