#include "verification/monkey/neighbourhood.h"

namespace wp::monkey {

using namespace fakes;

Neighbourhood::Neighbourhood(Dice& dice, Temper temper) : temper_(temper) {
    int count = 1 + dice.below(dice.percent(10) ? 300 : 12);
    for (int i = 0; i < count; ++i) names_.push_back("net" + std::to_string(i));
    names_.push_back("");
    names_.push_back(" ");
    names_.push_back("B\u00FCro\u202E\x1B[2J");
    names_.push_back("Cafe_NoMap");
    if (temper == Temper::wild)
        for (int i = 0; i < 4; ++i) names_.push_back("NET" + std::to_string(i));
    if (dice.percent(60)) joined_ = dice.oneOf(names_);
}

std::string Neighbourhood::name(Dice& dice) const {
    return dice.percent(80) ? dice.oneOf(names_) : "typed" + std::to_string(dice.below(3));
}

AccessPoint Neighbourhood::accessPoint(Dice& dice) const {
    AccessPoint point;
    if (!dice.percent(5)) point.ssid = dice.oneOf(names_);
    if (!dice.percent(5)) point.bssid = "02:" + std::to_string(dice.below(40));
    point.rssi = -90 + dice.below(70);
    return point;
}

void Neighbourhood::changeScan(Dice& dice, FakeDiagnosticsClient& service) const {
    if (dice.percent(10)) return service.setOutcome(kScanTest, failure(7, "radio busy"));
    if (dice.percent(5)) return service.setOutcome(kScanTest, {});
    if (dice.percent(5)) return service.setOutcome(kScanTest, outcome(false, true));
    std::vector<AccessPoint> heard;
    int count = dice.below(static_cast<int>(names_.size()) * 2);
    for (int i = 0; i < count; ++i) heard.push_back(accessPoint(dice));
    // In a calm life the joined access point is always heard, and no other one passes for it.
    if (temper_ == Temper::calm && joined_) heard.insert(heard.begin(), {*joined_, "02:joined", -50});
    service.setOutcome(kScanTest, scanOutcome(heard));
}

void Neighbourhood::changeStatus(Dice& dice, FakeDiagnosticsClient& service) const {
    if (temper_ == Temper::calm) {
        if (joined_) service.setJoinedNetwork(*joined_, "02:joined");
        return;
    }
    if (dice.percent(10)) {
        service.setStatus({nullptr, dice.percent(50) ? std::optional(Error{5, "no status"}) : std::nullopt});
    } else if (dice.percent(25)) {
        service.setJoinedNetwork(std::nullopt);
    } else {
        service.setJoinedNetwork(dice.oneOf(names_), "02:" + std::to_string(dice.below(40)));
    }
}

void Neighbourhood::change(Dice& dice, FakeDiagnosticsClient& service) {
    changeScan(dice, service);
    changeStatus(dice, service);
}

}  // namespace wp::monkey
