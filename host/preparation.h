#pragma once

#include <memory>
#include <optional>

#include "exchange/recording.h"
#include "exchange/service_process.h"
#include "host/arguments.h"
#include "host/configuration.h"
#include "host/locale.h"
#include "host/output_file.h"
#include "platform/value.h"
#include "screens/remote/script.h"

namespace wp::host {

/// All that a run needs from files and from the command line, read and checked before anything happens.
struct Preparation {
    DictionaryPointer parameters;
    LocaleChoice locale;
    Configuration configuration;
    std::optional<ServiceProcess> service;       ///< of a live run, ready to be asked
    std::shared_ptr<const Recording> recording;  ///< null: the run is live
    ScreenChoice screen = ScreenChoice::none;    ///< never `automatic`
    remote::Script script;
    std::optional<OutputFile> output;
    std::optional<OutputFile> record;
    std::optional<OutputFile> automation;
    std::optional<OutputFile> transcript;  ///< absent also for "-"
};

/// What `--locale` names, else the environment's. Throws `Exit` (status 2). *Main*.
LocaleChoice localeChoice(const std::optional<std::string>& name);

/// Throws `Exit` (status 2) with the first thing that is not acceptable. *Main*.
Preparation prepare(const RunOptions& options);

}  // namespace wp::host
