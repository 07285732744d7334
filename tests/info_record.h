#pragma once

#include "lifecycle/wifi_profile_view_controller.h"
#include "tests/test_row.h"

namespace wp {

template <class RecordType>
std::shared_ptr<const RecordType> WiFiProfileViewController::infoRecord(const TestRow& row,
                                                                        const Dictionary& info) const {
    std::optional<Value> value = info.value(row.infoKey);
    std::shared_ptr<const RecordType> record = value ? value->asRecord<RecordType>() : nullptr;
    if (!record) logNotFound(row.missingName);
    return record;
}

}  // namespace wp
