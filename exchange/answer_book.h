#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include "exchange/recording.h"
#include "platform/value.h"

namespace wp {

/// Whether the numbered test is one of the eleven of the device's own configuration, whose answers do not
/// depend on a network. *Any* thread.
bool isDeviceTest(int test);

/// The configuration's "NetworkName"; nothing where it has none. *Any* thread.
std::optional<std::string> networkNameIn(const DictionaryPointer& configuration);

/// The network that a test request is about: the one that its configuration names; nothing where it names none,
/// and for a test of the device's configuration. *Any* thread.
std::optional<std::string> networkOfRequest(int test, const DictionaryPointer& configuration);

/// Finds the recorded answer to each test request. Not for several threads at once.
///
/// Requests that are matched by exactly the same entries form one row: they take these entries one after
/// another, and the last entry serves all further ones. A request with another configuration that only some
/// of the entries match is of another row and counts for itself. So an entry may serve in several rows, an
/// answer given in one row is never missing in another, and what a request gets depends on earlier requests of
/// its own row alone.
class AnswerBook {
  public:
    /// The answers must outlive the book.
    explicit AnswerBook(const std::vector<RecordedAnswer>& answers);

    /// The answer to the next such request; null where no entry matches.
    const RecordedAnswer* next(int test, const DictionaryPointer& configuration);

  private:
    using Row = std::vector<const RecordedAnswer*>;

    std::map<int, Row> entriesByTest_;
    std::map<Row, std::size_t> served_;
};

}  // namespace wp
