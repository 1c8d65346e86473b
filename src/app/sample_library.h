#pragma once
// An invented, deterministic library so that every window has something real to show: several
// dozen securities of every record type with six years of weekday prices, classes, sectors and
// three chart lists. Nothing in it comes from real market data.
#include "platform/settings_store.h"
#include "platform/status.h"

#include <string>

namespace kori::app {

struct SampleSummary {
    int Securities = 0;
    int Records = 0;
    std::string LastDate;
};

// Writes Names.dat, the price files and the lists into `dataFolder`, IndClass.dat and
// Gics.dat into `systemFolder`, and the list names into the settings store.
platform::Status MakeSampleLibrary(const std::string& systemFolder, const std::string& dataFolder,
                                   platform::SettingsStore& settings, SampleSummary& summary);

} // namespace kori::app
