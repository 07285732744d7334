#pragma once

#include <string>
#include <vector>

namespace wp::host {

inline constexpr const char* kServiceFileName = "wifi-profile-service";

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

}  // namespace wp::host
