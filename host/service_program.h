#pragma once

#include <string>
#include <vector>

namespace wp::host {

/// The path of the program that looks at this machine; it stands beside this one. *Any*.
std::string serviceProgram();

/// What a program printed and with which status it ended; 127 when it could not be started.
struct ProgramOutput {
    int status = 0;
    std::string standardOutput;
    std::string standardError;
};

/// Runs a program to its end, without a shell and with nothing on its standard input. *Main*.
ProgramOutput runProgram(const std::string& path, const std::vector<std::string>& arguments);

/// What a live run with this configuration would contact, as the service tells it in JSON. Throws `Exit`
/// (status 2) with the service's line where the configuration is not acceptable. An empty file name stands for
/// no configuration of one's own. *Main*.
std::string contactedEndpoints(const std::string& configurationFile);

}  // namespace wp::host
