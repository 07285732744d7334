#pragma once

#include <sys/types.h>

#include <chrono>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "exchange/descriptor.h"
#include "exchange/json_reader.h"

namespace wp {

/// The path of a file that stands beside the running program. *Any* thread.
std::string besideProgram(const std::string& name);

/// A child process that inherits one end of a socket pair as descriptor 3 and nothing else but standard error:
/// it reads nothing from the terminal, writes nothing to standard output, and an interruption typed at the
/// terminal is not its business. Not for several threads at once.
class ServiceProcess {
  public:
    using Duration = std::chrono::milliseconds;

    /// Starts the program; a refusal says why that failed.
    static std::variant<ServiceProcess, Refusal> start(const std::string& path,
                                                       const std::vector<std::string>& arguments);

    ServiceProcess(ServiceProcess&& other) noexcept;
    ServiceProcess& operator=(ServiceProcess&&) = delete;
    /// Ends the process if it still runs.
    ~ServiceProcess();

    /// This side's end of the pair; it does not block.
    int socket() const { return socket_.number(); }

    /// The first line that the process sends, without its newline; what comes behind it is left to be read. Nothing
    /// when the process ends, closes the connection or says nothing that long.
    std::optional<std::string> firstLine(Duration patience);

    /// Waits that long for the process to end by itself; tells how it ended ("exit status 3", "signal 11,
    /// Segmentation fault"), nothing when it still runs.
    std::optional<std::string> waitForEnd(Duration patience);

    /// Closes the connection, upon which a healthy service ends; kills it when it has not ended that soon.
    /// Afterwards nothing of it is left.
    void end(Duration patience);

  private:
    ServiceProcess(pid_t process, Descriptor socket) : process_(process), socket_(std::move(socket)) {}
    bool reap();

    pid_t process_ = -1;  // -1: reaped
    Descriptor socket_;
    std::string howEnded_;
};

}  // namespace wp
