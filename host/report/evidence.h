#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "host/report/catalogue.h"
#include "platform/diagnostics.h"
#include "platform/value.h"

namespace wp::host {

/// The three sections of a result.
enum class Part { device, joined, selected };

/// What one request of a run was answered.
struct Answer {
    int testID = 0;
    std::optional<std::string>
        networkName;             ///< the network asked about; absent: the device or the joined one
    std::optional<bool> result;  ///< absent: no result
    DictionaryPointer info;      ///< null: none
    std::optional<Error> error;  ///< with a code other than 0
};

/// What a report is made from: a result alone, or a result with all the answers of its run.
struct Evidence {
    std::int64_t statusCode = 0;
    DictionaryPointer device = Dictionary::make();  ///< the sections, as in the result document; never null
    DictionaryPointer joined = Dictionary::make();
    DictionaryPointer selected = Dictionary::make();
    bool hasAnswers = false;
    std::vector<Answer> answers;            ///< in the order of the requests
    std::optional<std::string> joinedName;  ///< where it is known
    bool isStatusUntold = false;            ///< whether the device was asked for its network, and never told
    std::optional<std::string> selectedName;
};

/// The answer that says no more than this response. *Any*.
Answer answerFrom(int testID, std::optional<std::string> networkName,
                  const DiagnosticsTestResponse& response);

/// Evidence from a result's status code and data, alone or with the answers of its run. Names of networks are
/// taken from both. *Any*, when nothing writes to the data any more.
Evidence evidenceFrom(std::int64_t statusCode, const DictionaryPointer& data);
Evidence evidenceFrom(std::int64_t statusCode, const DictionaryPointer& data, std::vector<Answer> answers);

/// The result of a JSON object `{"statusCode", "data"}`; throws `Refused` (`exchange/json_reader.h`) with the
/// place where it is none. *Any*.
Evidence evidenceFromResult(const Value& json);

const DictionaryPointer& sectionOf(const Evidence& evidence, Part part);
/// The last answer to the test about that part; null where there is none.
const Answer* answerTo(const Evidence& evidence, Part part, int testID);
/// The test's verdict in the result; "foundScanResults" counts as true when it is 1.
std::optional<bool> verdictOf(const Evidence& evidence, Part part, const CatalogueEntry& test);
/// Whether the tests of the part ran, as far as the evidence tells.
bool wasTested(const Evidence& evidence, Part part);
/// Whether the test belongs to the part.
bool concerns(const CatalogueEntry& test, Part part);

/// What the service measured beyond the verdict: the info's "Details"; null where there is none.
DictionaryPointer detailsOf(const Evidence& evidence, Part part, int testID);

/// The value under the key as a number or a text.
std::optional<double> numberIn(const DictionaryPointer& dictionary, std::string_view key);
std::optional<std::string> textIn(const DictionaryPointer& dictionary, std::string_view key);
std::optional<bool> flagIn(const DictionaryPointer& dictionary, std::string_view key);
DictionaryPointer dictionaryIn(const DictionaryPointer& dictionary, std::string_view key);

}  // namespace wp::host
