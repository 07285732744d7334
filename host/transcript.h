#pragma once

#include <string>
#include <string_view>

namespace wp::host {

/// The snapshots that a script asks for, one line each, written as they are taken: to a file that begins
/// empty, to standard output, or nowhere. *Main*.
class Transcript {
  public:
    enum class Target { nowhere, standardOutput };

    explicit Transcript(Target target);
    /// Throws `Exit` (status 2) where the file cannot be written.
    explicit Transcript(const std::string& file);
    ~Transcript();
    Transcript(const Transcript&) = delete;
    Transcript& operator=(const Transcript&) = delete;

    /// Throws `Exit` (status 1) on failure.
    void add(std::string_view line);

  private:
    std::string name_;
    int descriptor_ = -1;
    bool isOwn_ = false;
};

}  // namespace wp::host
