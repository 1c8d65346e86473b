#pragma once
// The filter a day's maintenance bulletin goes through before its lines join Adjust.Lst: codes
// made safe as file names, market tags shortened, lines the library cannot use dropped, the
// ADJ indicator set by action, and the names of new listings shortened to fit.
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::adjust {

// How dividends enter the list (the `Divs` option).
enum class DividendRule {
    Leave = 1, // "Do not include dividends in list"
    MarkY = 2, // "Include dividends - Set ADJ indicator to Y"
    MarkN = 3, // "Include dividends - Set ADJ indicator to N"
    MarkD = 4  // "Include dividends - Set ADJ indicator to D"
};

struct BulletinOptions {
    std::string DateStem;        // "ddMMMyy" of the bulletin, the tag of Australian stocks
    bool OptionsLibrary = false; // an options library exists: ",OPT," lines are kept
    bool WarrantFilter = false;  // the Australian stock bulletin (.Asx.Btn) only
    bool NoWarrants = false;     // warrants are not kept at all
    bool NoShortNames = false;   // "Do NOT include Short Names ( NI's)"
    DividendRule Divs = DividendRule::Leave;
    // Whether a security has a price file (<code>.wdt): a warrant that stays needs one.
    std::function<bool(std::string_view code)> HasPriceFile;
};

// The bulletin's text, one item a line, filtered into the lines to append to Adjust.Lst (upper
// case, in bulletin order). Blank lines are dropped.
std::vector<std::string> FilterBulletin(std::string_view bulletin, const BulletinOptions& options);

// One NL name shortened by the two word tables (exposed for tests).
std::string ShortenListingLine(std::string line);

} // namespace kori::adjust
