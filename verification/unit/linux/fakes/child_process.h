#pragma once

#include <fcntl.h>
#include <gtest/gtest.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <string>
#include <vector>

extern char** environ;

namespace wp {

/// A program that a test starts and that ends with it, even where the test is killed: with the thread that makes this, to be
/// exact, which therefore has to live as long.
class ChildProcess {
  public:
    /// Starts the program and waits for its first line.
    explicit ChildProcess(const std::vector<std::string>& words) {
        int ends[2] = {};
        if (::pipe2(ends, O_CLOEXEC) != 0) return;
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_adddup2(&actions, ends[1], 1);
        std::vector<std::string> all = {"setpriv", "--pdeathsig", "KILL"};
        all.insert(all.end(), words.begin(), words.end());
        std::vector<char*> arguments;
        for (std::string& word : all) arguments.push_back(word.data());
        arguments.push_back(nullptr);
        const int failed = posix_spawnp(&pid_, arguments[0], &actions, nullptr, arguments.data(), environ);
        posix_spawn_file_actions_destroy(&actions);
        ::close(ends[1]);
        if (failed != 0) pid_ = -1;
        char c = 0;
        while (failed == 0 && ::read(ends[0], &c, 1) == 1 && c != '\n') firstLine_ += c;
        output_ = ends[0];
        EXPECT_FALSE(firstLine_.empty()) << words[0] << " did not start";
    }
    ChildProcess(const ChildProcess&) = delete;
    ~ChildProcess() { end(); }

    const std::string& firstLine() const { return firstLine_; }

    void end() {
        if (output_ >= 0) ::close(output_);
        output_ = -1;
        if (pid_ <= 0) return;
        ::kill(pid_, SIGKILL);
        ::waitpid(pid_, nullptr, 0);
        pid_ = -1;
    }

  private:
    pid_t pid_ = -1;
    int output_ = -1;
    std::string firstLine_;
};

}  // namespace wp
