#pragma once

#include "host/arguments.h"
#include "platform/value.h"

namespace wp::host {

/// The parameter dictionary of the run: the request file's object exactly as it stands, or the one that the
/// shorthands stand for: `{"maxScanCacheAge": 60, "reprofileWithUI": false}` changed by
/// `--max-scan-cache-age`,
/// `--list` and `--network` (key "networkName"). Throws `Exit` (status 2) for what is no JSON object. *Main*.
DictionaryPointer requestParameters(const RunOptions& options);

/// Whether the request asks for the list of networks. *Any*.
bool asksForList(const Dictionary& parameters);

}  // namespace wp::host
