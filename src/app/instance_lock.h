#pragma once
// One copy of the program an install root: an advisory lock on a file in the root, held for
// the life of the process and released by the system if the process dies.
#include "platform/dialogs.h"

#include <filesystem>
#include <memory>

namespace kori::app {

class InstanceLock {
public:
    InstanceLock(InstanceLock&& other) noexcept;
    InstanceLock& operator=(InstanceLock&& other) noexcept;
    InstanceLock(const InstanceLock&) = delete;
    InstanceLock& operator=(const InstanceLock&) = delete;
    ~InstanceLock();

    enum class Outcome { Acquired, HeldElsewhere, NoLockFile };
    // The lock when it is free; otherwise nullptr and, in `outcome`, why.
    static std::unique_ptr<InstanceLock> TryAcquire(const std::filesystem::path& root,
                                                    Outcome* outcome = nullptr);

private:
    explicit InstanceLock(int fd) : m_fd(fd) {}
    int m_fd = -1;
};

// The start-up test. False, after telling the user "You already have this application
// running.", when another copy holds the lock: the program then ends. When no lock file can be
// made at all (a read-only root) the program runs unguarded rather than not at all.
bool CheckSingleInstance(const std::filesystem::path& root, platform::Dialogs& dialogs,
                         std::unique_ptr<InstanceLock>& lock);

} // namespace kori::app
