#pragma once
// The name-file maintenance that kori names runs before it lists the file.
#include "app/session.h"
#include "cli/cli_context.h"

#include <string>

namespace kori::cli {

// Sorts the name file in one of the editor's orders ("code", "category", "industry", "gics"),
// or with `dedupe` by code with the duplicates removed (the count printed), and saves it as
// the editor does: names.bak kept, chart lists re-linked.
void RunNamesMaintenance(CliContext& ctx, app::Session& session, const std::string& sort,
                         bool dedupe);

} // namespace kori::cli
