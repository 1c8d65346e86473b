#include "app/instance_lock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <utility>

namespace kori::app {

InstanceLock::InstanceLock(InstanceLock&& other) noexcept : m_fd(std::exchange(other.m_fd, -1)) {}

InstanceLock& InstanceLock::operator=(InstanceLock&& other) noexcept {
    if (this != &other) {
        if (m_fd >= 0) ::close(m_fd);
        m_fd = std::exchange(other.m_fd, -1);
    }
    return *this;
}

InstanceLock::~InstanceLock() {
    if (m_fd >= 0) ::close(m_fd); // closing the descriptor drops the lock
}

std::unique_ptr<InstanceLock> InstanceLock::TryAcquire(const std::filesystem::path& root,
                                                       Outcome* outcome) {
    Outcome ignored{};
    Outcome& result = outcome ? *outcome : ignored;
    const std::string path = (root / "kori.lock").string();
    const int fd = ::open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0644);
    if (fd < 0) {
        result = Outcome::NoLockFile;
        return nullptr;
    }
    if (::flock(fd, LOCK_EX | LOCK_NB) != 0) {
        ::close(fd);
        result = Outcome::HeldElsewhere;
        return nullptr;
    }
    result = Outcome::Acquired;
    return std::unique_ptr<InstanceLock>(new InstanceLock(fd));
}

bool CheckSingleInstance(const std::filesystem::path& root, platform::Dialogs& dialogs,
                         std::unique_ptr<InstanceLock>& lock) {
    InstanceLock::Outcome outcome{};
    lock = InstanceLock::TryAcquire(root, &outcome);
    if (outcome != InstanceLock::Outcome::HeldElsewhere) return true;
    dialogs.MsgBox("You already have this application running.", "Kori Charting 8",
                   platform::Buttons::Ok, platform::Icon::Exclamation);
    return false;
}

} // namespace kori::app
