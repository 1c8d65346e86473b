#pragma once
// A session over the sample library in a throw-away root, with scripted dialogs: the start of
// every test of the chart road. Header-only so that only the tests that use the app link it.
#include "app/sample_library.h"
#include "app/session.h"
#include "app/start_up.h"
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "platform/settings_store.h"
#include "store/name_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::test {

struct SampleSession {
    TempRoot root;
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    platform::SettingsStore settings{root.path() / "settings.ini"};
    platform::FixedClock clock{"20261120"};
    app::Session session{root.path(), platform::Services{dialogs, progress, settings, clock}};

    SampleSession() {
        dialogs.QueueAnswer(platform::Answer::Yes); // a colour printer
        dialogs.QueueAnswer(platform::Answer::No);  // white stays white
        app::InitialiseSession(session, "");
        app::SampleSummary summary;
        const auto s = app::MakeSampleLibrary(session.folders.SystemFolder,
                                              session.folders.DataFolder, settings, summary);
        EXPECT_TRUE(s.ok()) << s.message();
        dialogs.clear();
    }

    // The name record of a sample code; a failed test when the library lacks it.
    store::NameRecord Name(std::string_view code) const {
        platform::Status why;
        const auto found = store::FindCode(session.folders.DataFolder, code, why);
        EXPECT_TRUE(found) << code << ": " << why.message();
        return found ? found->Record : store::NameRecord{};
    }
};

} // namespace kori::test
