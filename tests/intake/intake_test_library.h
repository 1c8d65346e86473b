#pragma once
// A small library in a throw-away folder for the update tests: a data folder, a download
// folder and a system folder, with builders for name and price files and readers of the result.
#include "intake/download_update.h"
#include "platform/dialogs.h"
#include "platform/files.h"
#include "platform/progress.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

namespace kori::test {

inline store::PriceRecord Rec(const char* date, float o, float h, float l, float c, int v) {
    store::PriceRecord r;
    r.Date = date;
    r.Open = o;
    r.High = h;
    r.Low = l;
    r.Close = c;
    r.Volume = v;
    return r;
}

inline store::NameRecord NameOf(const char* code, std::int16_t type = 4,
                                std::int16_t category = 1) {
    store::NameRecord n;
    n.Code = code;
    n.Name = std::string(code) + " Ltd";
    n.RecordType = type;
    n.Category = category;
    return n;
}

struct IntakeLibrary {
    TempRoot root;
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    intake::UpdateSettings settings;
    intake::UpdateHooks hooks;

    IntakeLibrary() {
        for (const char* f : {"data", "download", "system"})
            std::filesystem::create_directory(root.path() / f);
        settings.DataService = 4;
        settings.DataFolder = root.folder() + "data/";
        settings.DownloadFolder = root.folder() + "download/";
        settings.SystemFolder = root.folder() + "system/";
    }

    std::string Folder(const std::string& sub) const { return root.folder() + sub + "/"; }

    void Names(const std::vector<store::NameRecord>& names, const std::string& folder = "") {
        store::NameFile nf(store::NameFile::PathIn(folder.empty() ? settings.DataFolder : folder));
        ASSERT_TRUE(nf.WriteAll(names).ok());
    }
    void Prices(const char* code, const std::vector<store::PriceRecord>& records,
                const std::string& folder = "") {
        store::PriceFile pf(
            store::PriceFile::PathFor(folder.empty() ? settings.DataFolder : folder, code));
        ASSERT_TRUE(pf.WriteAll(records).ok());
    }
    void DayFile(const std::string& name, const std::string& text) const {
        std::ofstream(settings.DownloadFolder + name, std::ios::binary) << text;
    }

    std::vector<store::PriceRecord> Read(const char* code, const std::string& folder = "") const {
        std::vector<store::PriceRecord> out;
        store::PriceFile pf(
            store::PriceFile::PathFor(folder.empty() ? settings.DataFolder : folder, code));
        EXPECT_TRUE(pf.ReadAll(out).ok());
        return out;
    }
    std::vector<store::NameRecord> ReadNames(const std::string& folder = "") const {
        std::vector<store::NameRecord> out;
        store::NameFile nf(store::NameFile::PathIn(folder.empty() ? settings.DataFolder : folder));
        EXPECT_TRUE(nf.ReadAll(out).ok());
        return out;
    }
    bool Waiting(const std::string& name) const {
        return std::filesystem::exists(settings.DownloadFolder + name);
    }

    intake::RunResult Run(const std::string& file, const std::string& date = "20240104") {
        intake::UpdateHost host{dialogs, progress, nullptr, nullptr};
        return intake::RunDownloadUpdate(settings, host, hooks, file, date, false);
    }
};

} // namespace kori::test
