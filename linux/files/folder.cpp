#include "linux/files/folder.h"

#include <algorithm>
#include <filesystem>

namespace wp {

std::vector<std::string> namesIn(const std::string& folder, std::size_t most) {
    std::vector<std::string> names;
    std::error_code failed;
    for (std::filesystem::directory_iterator each(folder, failed), end;
         !failed && each != end && names.size() < most; each.increment(failed))
        names.push_back(each->path().filename());
    std::ranges::sort(names);
    return names;
}

}  // namespace wp
