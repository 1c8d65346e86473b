#include "store/two_thread_walk.h"

#include <atomic>
#include <thread>
#include <vector>

namespace kori::store {

namespace {

// Passes the cancel flag and the events through while the walk only gathers: the bar is moved
// by the work, which is where the time goes.
class GatherProgress : public platform::Progress {
public:
    explicit GatherProgress(platform::Progress& outer) : m_outer(outer) {}
    void SetStatus(std::string_view text) override { m_outer.SetStatus(text); }
    void SetRange(long long maximum) override { m_outer.SetRange(maximum); }
    void SetValue(long long) override {}
    void Yield() override { m_outer.Yield(); }
    bool Cancelled() const override { return m_outer.Cancelled(); }

private:
    platform::Progress& m_outer;
};

} // namespace

WalkResult WalkOnTwoThreads(const SecurityList& list, platform::Progress& progress,
                            const std::function<void(int, const WalkItem&)>& work) {
    std::vector<WalkItem> items;
    GatherProgress gather(progress);
    WalkResult result = ForEachSecurity(list, gather, [&](const WalkItem& i) {
        items.push_back(i);
        return WalkStep::Continue;
    });
    if (!result.Status || result.Cancelled || items.empty()) return result;

    std::atomic<std::size_t> next{0};
    std::atomic<bool> stop{false};
    auto take = [&](int thread) {
        for (;;) {
            if (stop.load(std::memory_order_relaxed)) return;
            const std::size_t i = next.fetch_add(1);
            if (i >= items.size()) return;
            work(thread, items[i]);
        }
    };
    std::thread helper(take, 1);
    // The calling thread works too, and between securities moves the bar and polls the cancel.
    for (;;) {
        const std::size_t i = next.fetch_add(1);
        if (i >= items.size()) break;
        work(0, items[i]);
        progress.SetValue(items[i].Position);
        progress.Yield();
        if (progress.Cancelled()) {
            stop = true;
            result.Cancelled = true;
            break;
        }
    }
    helper.join();
    return result;
}

} // namespace kori::store
