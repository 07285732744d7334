#pragma once

#include "platform/value.h"
#include "service/known.h"

namespace wp {

/// What a numbered test found.
struct Finding {
    bool result = false;
    bool didPass = false;
    DictionaryPointer info;  ///< null where the test has no information
};

/// A finding, or the reason why the test cannot tell.
using Outcome = Known<Finding>;

/// A test that asks whether something is wrong: it passes when it is not. *Any* thread.
Outcome problem(bool found, Dictionary::Entries info = {});
/// A test that asks whether something works: it passes when it does. *Any* thread.
Outcome works(bool found, Dictionary::Entries info = {});

}  // namespace wp
