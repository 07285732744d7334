#pragma once

#include <optional>
#include <string_view>

#include "exchange/place.h"
#include "platform/records.h"
#include "platform/value.h"

namespace wp {

/// The object that stands for a service record in JSON. *Any* thread.
Value encodeRecord(const Record& record);

/// Whether values under this key of an info dictionary are service records.
bool isRecordKey(std::string_view infoKey);

/// The record (for "ScanResults": the array of records) that the JSON value under this key stands for. Fields
/// that are absent or null: loss and times NaN, integers and the timestamp 0, flags false, texts and dates
/// absent. Throws `Refused`.
Value decodeRecord(std::string_view infoKey, const Value& json, const Place& place);

}  // namespace wp
