#pragma once

#include <sys/types.h>

#include <filesystem>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>

namespace wp::host {

/// Writes all bytes to the descriptor; the error's text on failure. *Any*.
std::optional<std::string> writeAll(int descriptor, std::string_view bytes);

/// The file that the path leads to in the end, all links followed, whether there is one yet or not. *Any*.
std::filesystem::path finalFile(const std::string& path);

enum class FileUse { read, written };

/// What an option names: no file, a file, or `-` for a standard stream.
struct NamedFile {
    const char* option;
    std::optional<std::string> path;
    FileUse use;
};

/// Throws `Exit` (status 2) where a file is to be written that an option before it names too: what is read from
/// it would be lost, or one output the other. *Main*.
void refuseOneFileForTwo(std::initializer_list<NamedFile> files);

/// A file that is written whole or not at all: the bytes go to a new file beside it, which takes its place
/// when they are on the disk. An earlier file keeps its mode, and survives every failure. What is no regular
/// file (a device, a pipe) is written as it stands. *Main*.
class OutputFile {
  public:
    /// Checks that the file can be put there, and throws `Exit` (status 2) naming the option where it cannot.
    /// With a mode given the file gets exactly that one.
    OutputFile(std::string option, std::string path, std::optional<mode_t> mode = std::nullopt);

    /// Throws `Exit` (status 1) on failure; the earlier file is untouched then.
    void write(std::string_view bytes) const;

    const std::string& path() const { return path_; }

  private:
    void writeInPlace(std::string_view bytes) const;
    void replace(std::string_view bytes) const;
    [[noreturn]] void failToWrite(const std::string& reason) const;

    std::string option_;
    std::string path_;
    std::optional<mode_t> mode_;
    bool isRegular_ = true;
};

}  // namespace wp::host
