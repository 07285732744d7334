#include "linux/scan_row.h"

#include <algorithm>
#include <array>

namespace wp {
namespace {

/// Channels 1, 6 and 11, which alone do not overlap; then those of 5 GHz on which no radar must be waited for.
constexpr std::array<std::uint32_t, 12> kLikely = {2412, 2437, 2462, 5180, 5200, 5220,
                                                   5240, 5745, 5765, 5785, 5805, 5825};

}  // namespace

void putLikelyFirst(std::vector<RadioChannel>& channels, std::optional<std::uint32_t> home) {
    const auto rank = [&](const RadioChannel& each) {
        return each.frequency == home ? 0 : std::ranges::count(kLikely, each.frequency) > 0 ? 1 : 2;
    };
    std::ranges::stable_sort(channels, {}, rank);
}

ScanRow::ScanRow(ScanOrder order, ScanSlicing slicing)
    : order_(std::move(order)), slicing_(slicing), remaining_(order_.frequencies) {
    if (remaining_.empty()) slicing_.wanted = false;
}

ScanOrder ScanRow::next() const {
    ScanOrder next = order_;
    next.frequencies = remaining_;
    if (slicing_.wanted) next.frequencies.resize(1);
    return next;
}

std::optional<HomeChannel::Visit> ScanRow::visit() const {
    if (!slicing_.wanted) return HomeChannel::Visit::lengthy;
    if (remaining_.front() == slicing_.home) return std::nullopt;
    return HomeChannel::Visit::brief;
}

std::chrono::milliseconds ScanRow::pause() const {
    return wasAway_ ? kAtHome : std::chrono::milliseconds(0);
}

/// Whether a scan of others finds on its channels what this one would.
bool ScanRow::isAsGood(const ScanEvent& event) const {
    return order_.probeForAll && order_.names.empty() && event.probedForAll;
}

void ScanRow::ended(Whose whose, const ScanEvent& event) {
    const std::vector<std::uint32_t> asked = next().frequencies;
    const bool own = whose == Whose::own;
    wasAway_ = slicing_.wanted && !(own && asked.front() == slicing_.home);
    ++starts_;
    wasHeard_ |= own && event.kind == ScanEvent::Kind::finished;
    if (event.kind != ScanEvent::Kind::finished)
        aborts_ += own ? 1 : 0;
    else if (own)
        leaveOut(asked);
    else if (isAsGood(event))
        leaveOut(event.frequencies);
}

bool ScanRow::skip() {
    const bool isSkipped = slicing_.wanted && wasHeard_;
    if (isSkipped) leaveOut(next().frequencies);
    return isSkipped;
}

void ScanRow::leaveOut(std::span<const std::uint32_t> visited) {
    const auto isVisited = [&](std::uint32_t each) { return std::ranges::count(visited, each) > 0; };
    if (std::erase_if(remaining_, isVisited) > 0) starts_ = aborts_ = 0;
    isComplete_ = remaining_.empty();
}

}  // namespace wp
