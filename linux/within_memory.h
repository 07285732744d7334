#pragma once

#include <new>

#include "service/known.h"

namespace wp {

/// What the function returns, a fact or why there is none; where memory runs out meanwhile, that is the reason. *Any* thread.
template <class Function>
auto withinMemory(Function function) -> decltype(function()) {
    try {
        return function();
    } catch (const std::bad_alloc&) {
        return failure(Reason::unavailable, "there is not enough memory");
    }
}

}  // namespace wp
