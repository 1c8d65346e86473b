#pragma once
// The name-file check (NameData): asked for first, then the findings as a report, and the two
// remedies, each after its own question.
#include "app/grid_model.h"
#include "app/session.h"
#include "maint/name_check.h"

#include <string>

namespace kori::app {

inline constexpr const char* kNameDataTitle = "Check Name File - Data Files";
inline constexpr const char* kNameDataQuestion =
    "The name file will be checked against the price files of the data folder.  Continue ?";

class NameDataForm {
public:
    explicit NameDataForm(Session& session) : m_session(session) {}

    // The question of the menu item; true when the user goes on.
    bool Ask();
    // Reads the folder again; false (after a message) when the name file cannot be read.
    bool Check();
    const maint::NameCheckResult& result() const { return m_result; }

    // "50 name records, 49 price files: 2 findings".
    std::string Summary() const;
    // Code, Record, Finding, Detail.
    GridModel Report() const;

    int Missing() const { return m_addable; }
    int WithoutData() const { return m_result.Count(maint::name_finding::NoPriceFile); }
    // Each asks first; the name file is then rewritten, the findings read again and what was
    // done said. False when the user said no or nothing was there to do.
    bool AddMissing(platform::Progress& progress);
    bool RemoveWithoutData(platform::Progress& progress);

private:
    bool Fix(bool add, platform::Progress& progress);

    Session& m_session;
    maint::NameCheckResult m_result;
    int m_addable = 0;
};

} // namespace kori::app
