#pragma once

#include "host/report/checks.h"
#include "host/report/texts.h"

namespace wp::host {

/// What the test measured, with its unit, in display form; empty where nothing was. *Any*.
std::string measuredText(const Evidence& evidence, const Check& check, const Texts& texts);

/// The security that the document names ("WPA2/WPA3 Personal") as people call it. *Any*.
std::string securityText(const std::string& security, const Texts& texts);

/// A network's name in quotes and in display form; empty for an unknown one. *Any*.
std::string networkText(const std::optional<std::string>& name, const Texts& texts);

}  // namespace wp::host
