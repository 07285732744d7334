#pragma once

#include <functional>
#include <string>
#include <vector>

namespace wp {

/// Calls with the words of the command line of each process that this user sees; there is at least one. A program that shows a
/// title of its own there ("dhcpcd: wlan0 [ip4]") has one text in place of words, which is parted at blanks. *Any* thread.
/// \param root a root folder
void forEachProcess(const std::string& root,
                    const std::function<void(const std::vector<std::string>&)>& call);

/// Whether a program of this name runs; where other users' processes are hidden it may. *Any* thread.
/// \param root a root folder
bool mayRun(const std::string& program, const std::string& root);

/// The name of a program that a word of a command line names by its path.
std::string programOf(const std::string& word);

}  // namespace wp
