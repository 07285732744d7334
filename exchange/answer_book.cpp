#include "exchange/answer_book.h"

#include <algorithm>
#include <array>

namespace wp {
namespace {

/// Every number kind that JSON knows, without loss: a long double holds 64-bit integers.
std::optional<long double> number(const Value& value) {
    if (const auto* whole = value.as<std::int64_t>()) return *whole;
    if (const auto* whole = value.as<std::uint64_t>()) return *whole;
    if (const auto* fraction = value.as<double>()) return *fraction;
    return std::nullopt;
}

bool matchesAge(const RecordedAnswer& answer, const DictionaryPointer& configuration) {
    if (!answer.maxScanCacheAge) return true;
    std::optional<Value> wanted = configuration ? configuration->value("MaxScanCacheAge") : std::nullopt;
    return wanted && number(*wanted) && number(*wanted) == number(*answer.maxScanCacheAge);
}

}  // namespace

bool isDeviceTest(int test) {
    constexpr std::array<int, 11> deviceTests{14, 15, 16, 17, 18, 19, 20, 22, 29, 47, 48};
    return std::find(deviceTests.begin(), deviceTests.end(), test) != deviceTests.end();
}

std::optional<std::string> networkNameIn(const DictionaryPointer& configuration) {
    std::optional<Value> name = configuration ? configuration->value("NetworkName") : std::nullopt;
    const auto* text = name ? name->as<std::string>() : nullptr;
    return text ? std::optional(*text) : std::nullopt;
}

std::optional<std::string> networkOfRequest(int test, const DictionaryPointer& configuration) {
    return isDeviceTest(test) ? std::nullopt : networkNameIn(configuration);
}

AnswerBook::AnswerBook(const std::vector<RecordedAnswer>& answers) {
    for (const RecordedAnswer& answer : answers) entriesByTest_[answer.test].push_back(&answer);
}

const RecordedAnswer* AnswerBook::next(int test, const DictionaryPointer& configuration) {
    auto entries = entriesByTest_.find(test);
    if (entries == entriesByTest_.end()) return nullptr;
    std::optional<std::string> network = networkOfRequest(test, configuration);
    Row row;
    for (const RecordedAnswer* answer : entries->second) {
        bool matchesName = isDeviceTest(test) || answer->networkName == network;
        if (matchesName && matchesAge(*answer, configuration)) row.push_back(answer);
    }
    if (row.empty()) return nullptr;
    std::size_t& served = served_[row];
    const RecordedAnswer* answer = row[std::min(served, row.size() - 1)];
    ++served;
    return answer;
}

}  // namespace wp
