#pragma once
// A walk over the library on both cores: the securities are gathered by the one shared walk
// (limits, issues, cancel), then worked on two threads that take them in walk order. The calling
// thread keeps the progress: it moves the bar as securities are done and polls the cancel flag,
// which stops both threads; what was done before the cancel is kept.
#include "platform/progress.h"
#include "store/security_walk.h"

#include <functional>

namespace kori::store {

// `work(thread, item)` runs for each security; `thread` is 0 or 1, so that each thread keeps
// its own buffers and finds. Returns the walk's result (Cancelled also when the work was).
WalkResult WalkOnTwoThreads(const SecurityList& list, platform::Progress& progress,
                            const std::function<void(int, const WalkItem&)>& work);

} // namespace kori::store
