#pragma once

#include <gtest/gtest.h>

#include "verification/unit/fakes/diagnostic_run.h"
#include "verification/unit/fakes/printing.h"
#include "verification/unit/tests/catalogue_rows.h"

namespace wp::rows {

/// A controller that is set up, with operations of the catalogue run on it one by one.
class CatalogueTest : public ::testing::Test {
  protected:
    /// Runs the row's operation; a network operation with the dictionaries below.
    void run(const Row& row) { run(row, configuration, results); }

    void run(const Row& row, const DictionaryPointer& configurationGiven,
             const DictionaryPointer& resultsGiven) {
        if (row.deviceOperation) {
            (controller.*row.deviceOperation)();
        } else {
            (controller.*row.networkOperation)(configurationGiven, resultsGiven);
        }
    }

    /// The section that the row's operation writes.
    const DictionaryPointer& written(const Row& row) {
        return row.deviceOperation ? controller.deviceData() : results;
    }

    std::vector<std::string> logLines() { return device.log.lines(3); }

    fakes::DiagnosticRun diagnosticRun;
    fakes::FakeDevice& device = diagnosticRun.device;
    fakes::FakeDiagnosticsClient& service = device.service;
    WiFiProfileViewController& controller = *diagnosticRun.controller;
    DictionaryPointer configuration = Dictionary::make({{"MaxScanCacheAge", 30u}, {"NetworkName", "Office"}});
    DictionaryPointer results = Dictionary::make();
};

/// The same, once for each row.
class CatalogueRowTest : public CatalogueTest, public ::testing::WithParamInterface<Row> {};

}  // namespace wp::rows
