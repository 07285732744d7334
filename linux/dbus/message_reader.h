#pragma once

#include "linux/dbus/bus_value.h"
#include "service/known.h"

struct sd_bus_message;

namespace wp {

/// Bounds of one message; nobody who keeps to the bus's purpose comes near them.
inline constexpr unsigned kDeepestValue = 16, kMostValues = 200'000;
inline constexpr std::size_t kMostBytes = 8U << 20;

/// Reads the whole body of a message, in host order, from its start: its only value, or a list of its values.
/// What goes beyond the bounds is malformed.
Known<BusValue> readBody(sd_bus_message* message);

}  // namespace wp
