#include "host/output_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <filesystem>

#include "host/exit.h"

namespace wp::host {
namespace {

namespace fs = std::filesystem;

std::string errorText() {
    return std::strerror(errno);
}

/// A new file beside the wanted one, removed again unless it took the other's place.
class NewFile {
  public:
    explicit NewFile(const std::string& path) {
        fs::path folder = fs::path(path).parent_path();
        for (int attempt = 0; attempt < 100 && descriptor_ < 0; ++attempt) {
            // A name of its own: with anything added the wanted file's could be too long.
            std::string name =
                ".wifi-profile-" + std::to_string(getpid()) + "-" + std::to_string(attempt) + ".new";
            path_ = (folder / name).string();
            descriptor_ = open(path_.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
            if (descriptor_ < 0 && errno != EEXIST) return;
        }
    }
    ~NewFile() {
        if (descriptor_ < 0) return;
        close(descriptor_);
        if (!isMoved_) unlink(path_.c_str());
    }
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    int descriptor() const { return descriptor_; }
    bool moveTo(const std::string& path) {
        isMoved_ = rename(path_.c_str(), path.c_str()) == 0;
        return isMoved_;
    }

  private:
    std::string path_;
    int descriptor_ = -1;
    bool isMoved_ = false;
};

void syncFolder(const fs::path& folder) {
    int descriptor = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (descriptor < 0) return;
    fsync(descriptor);
    close(descriptor);
}

}  // namespace

fs::path finalFile(const std::string& path) {
    constexpr int kMostLinks = 40;  // as many as the system follows
    std::error_code error;
    fs::path file = fs::absolute(path, error);
    for (int links = 0; links <= kMostLinks; ++links) {
        fs::path target = fs::weakly_canonical(file, error);
        if (error) return file;
        // A link to a file that is not there yet is no canonical path: it is followed by hand.
        fs::path next = fs::read_symlink(target, error);
        if (error) return target;
        file = target.parent_path() / next;
    }
    return file;
}

std::optional<std::string> writeAll(int descriptor, std::string_view bytes) {
    while (!bytes.empty()) {
        ssize_t count = ::write(descriptor, bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) return errorText();
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
    return std::nullopt;
}

void refuseOneFileForTwo(std::initializer_list<NamedFile> files) {
    for (const NamedFile& first : files) {
        const bool isStream = first.path == "-" && first.use == FileUse::read;
        if (!first.path || first.path == "/dev/null" || isStream) continue;
        for (const NamedFile* second = &first + 1; second != files.end(); ++second) {
            if (second->use == FileUse::read || !second->path) continue;
            if (finalFile(*first.path) != finalFile(*second->path)) continue;
            const std::string other = first.use == FileUse::read
                                          ? std::string("that ") + first.option + " reads"
                                          : std::string("of ") + first.option + " too";
            refuse(std::string(second->option) + ": " + *second->path + ": is the file " + other +
                   "; give another");
        }
    }
}

OutputFile::OutputFile(std::string option, std::string path, std::optional<mode_t> mode)
    : option_(std::move(option)), path_(std::move(path)), mode_(mode) {
    std::string place = option_ + ": " + path_ + ": ";
    struct stat status {};
    if (stat(path_.c_str(), &status) == 0) {
        if (S_ISDIR(status.st_mode)) refuse(place + "is a folder; give a file");
        if (access(path_.c_str(), W_OK) != 0) refuse(place + "cannot be written: " + errorText());
        isRegular_ = S_ISREG(status.st_mode);
        if (!isRegular_) return;
    } else if (errno != ENOENT || path_.ends_with('/')) {
        refuse(place + "cannot be written: " + (errno == ENOENT ? "no such folder" : errorText()));
    }
    fs::path folder = finalFile(path_).parent_path();
    if (access(folder.c_str(), W_OK | X_OK) != 0)
        refuse(place + "cannot be written: its folder: " + errorText());
}

void OutputFile::write(std::string_view bytes) const {
    if (isRegular_) {
        replace(bytes);
    } else {
        writeInPlace(bytes);
    }
}

void OutputFile::writeInPlace(std::string_view bytes) const {
    int descriptor = open(path_.c_str(), O_WRONLY | O_CLOEXEC);
    if (descriptor < 0) failToWrite(errorText());
    std::optional<std::string> error = writeAll(descriptor, bytes);
    close(descriptor);
    if (error) failToWrite(*error);
}

void OutputFile::replace(std::string_view bytes) const {
    std::string target = finalFile(path_).string();
    NewFile file(target);
    if (file.descriptor() < 0) failToWrite(errorText());
    struct stat earlier {};
    bool isReplacing = stat(target.c_str(), &earlier) == 0;
    std::optional<mode_t> mode = mode_;
    if (!mode && isReplacing) mode = earlier.st_mode & 07777;
    if (isReplacing && (earlier.st_uid != geteuid() || earlier.st_gid != getegid())) {
        // Only root may give a file away; for anybody else the new file is the writer's own.
        if (fchown(file.descriptor(), earlier.st_uid, earlier.st_gid) != 0) errno = 0;
    }
    if (mode && fchmod(file.descriptor(), *mode) != 0) failToWrite(errorText());
    if (std::optional<std::string> error = writeAll(file.descriptor(), bytes)) failToWrite(*error);
    if (fsync(file.descriptor()) != 0) failToWrite(errorText());
    if (!file.moveTo(target)) failToWrite(errorText());
    syncFolder(fs::path(target).parent_path());
}

void OutputFile::failToWrite(const std::string& reason) const {
    fail(option_ + ": " + path_ + ": not written: " + reason);
}

}  // namespace wp::host
