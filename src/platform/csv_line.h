#pragma once
// Splitting one line of a delimited text file into fields, with double quotes as the files
// written by spreadsheets and download services use them.
#include <string>
#include <string_view>
#include <vector>

namespace kori::platform {

// Fields of `line` split at `separator`. A field may stand in double quotes, inside which the
// separator is kept and "" stands for one quote; blanks around a quoted field are dropped.
// A trailing CR is ignored. An empty line gives one empty field.
std::vector<std::string> SplitQuoted(std::string_view line, char separator = ',');

// The number of separators of `line` outside quotes.
int CountSeparators(std::string_view line, char separator = ',');

} // namespace kori::platform
