#pragma once

#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <string>

namespace wp::fakes {

/// A folder of a test's own, gone with it and with everything in it.
class TemporaryFolder {
  public:
    TemporaryFolder() : path_(std::filesystem::temp_directory_path() / "wifi-profile-XXXXXX") {
        if (!mkdtemp(path_.data())) ADD_FAILURE() << path_ << ": cannot be made";
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;
    ~TemporaryFolder() { std::filesystem::remove_all(path_); }

    const std::string& path() const { return path_; }
    /// Where a file of this name lies.
    std::string operator/(const std::string& name) const { return path_ + "/" + name; }
    /// Writes a file, and the folders in which it lies.
    void write(const std::string& name, const std::string& content) const {
        const std::filesystem::path file = *this / name;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary) << content;
    }

  private:
    std::string path_;
};

}  // namespace wp::fakes
