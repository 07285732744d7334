#pragma once

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "service/bytes.h"
#include "verification/unit/places.h"

namespace wp {

/// The messages that a kernel answered in a scenario of the lab (`verification/data/netlink/`).
inline std::vector<std::uint8_t> captured(const std::string& name) {
    std::ifstream file(sourceFolder() + "/verification/data/netlink/" + name + ".bin", std::ios::binary);
    EXPECT_TRUE(file) << name;
    return {std::istreambuf_iterator<char>(file), {}};
}

}  // namespace wp
