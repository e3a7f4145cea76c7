// Atomic, durable file replacement in one locked directory (write, fdatasync, rename, fsync).
#include "Store/DurableDirectory.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <sys/uio.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <stdexcept>

#include "Quorvex/Log.h"

namespace Configuration {
namespace {

std::runtime_error systemError(const std::string& what, const std::string& path) {
    return std::runtime_error("DurableDirectory: " + what + " " + path + ": " +
                              std::strerror(errno));
}

// Writes every part, resuming after short writes and interruptions.
bool writeAll(int fd, std::vector<DurableDirectory::Part> parts) {
    std::vector<iovec> iov;
    for (const DurableDirectory::Part& part : parts) {
        if (part.size > 0) {
            iov.push_back(iovec{const_cast<void*>(part.data), part.size});
        }
    }
    std::size_t first = 0;
    while (first < iov.size()) {
        const int count = static_cast<int>(std::min<std::size_t>(iov.size() - first, IOV_MAX));
        const ssize_t written = ::writev(fd, &iov[first], count);
        if (written < 0) {
            if (errno == EINTR) {
                continue;
            }
            return false;
        }
        std::size_t left = static_cast<std::size_t>(written);
        while (first < iov.size() && left >= iov[first].iov_len) {
            left -= iov[first].iov_len;
            ++first;
        }
        if (left > 0) {
            iov[first].iov_base = static_cast<char*>(iov[first].iov_base) + left;
            iov[first].iov_len -= left;
        }
    }
    return true;
}

int fsyncRetrying(int fd, bool dataOnly) {
    int result;
    do {
        result = dataOnly ? ::fdatasync(fd) : ::fsync(fd);
    } while (result != 0 && errno == EINTR);
    return result;
}

}  // namespace

DurableDirectory::DurableDirectory(const std::string& path) {
    std::error_code error;
    m_path = std::filesystem::absolute(path, error).lexically_normal().string();
    if (m_path.size() > 1 && m_path.back() == '/') {
        m_path.pop_back();
    }
    std::filesystem::create_directories(m_path, error);
    m_dirFd = ::open(m_path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (m_dirFd < 0) {
        throw systemError("cannot open directory", m_path);
    }
    try {
        lockDirectory();
        removeTemporaries();
    } catch (...) {
        if (m_lockFd >= 0) {
            ::close(m_lockFd);
        }
        ::close(m_dirFd);
        throw;
    }
}

DurableDirectory::~DurableDirectory() {
    ::close(m_lockFd);  // releases the flock
    ::close(m_dirFd);
}

void DurableDirectory::lockDirectory() {
    m_lockFd = ::openat(m_dirFd, kLockName, O_RDWR | O_CREAT | O_CLOEXEC, 0600);
    if (m_lockFd < 0) {
        throw systemError("cannot create lock file in", m_path);
    }
    if (::flock(m_lockFd, LOCK_EX | LOCK_NB) != 0) {
        if (errno == EWOULDBLOCK) {
            throw std::runtime_error("DurableDirectory: directory " + m_path +
                                     " is in use by another store (lock file " + kLockName + ")");
        }
        throw systemError("cannot lock", m_path);
    }
}

void DurableDirectory::removeTemporaries() {
    const std::size_t prefixLength = std::strlen(kTempPrefix);
    bool removed = false;
    for (const std::string& name : entries()) {
        if (name.compare(0, prefixLength, kTempPrefix) == 0) {
            QUORVEX_LOG(LM_INFO, "DurableDirectory: removing unfinished write %s\n", name.c_str());
            ::unlinkat(m_dirFd, name.c_str(), 0);
            removed = true;
        }
    }
    if (removed && fsyncRetrying(m_dirFd, false) != 0) {
        throw systemError("cannot sync", m_path);
    }
}

bool DurableDirectory::takeSpare(std::size_t size, std::string& name, std::size_t& spareSize) {
    std::lock_guard<std::mutex> lock(m_spareMutex);
    if (m_spares.empty()) {
        return false;
    }
    auto it = m_spares.find(size);
    if (it == m_spares.end()) {
        it = m_spares.begin();
    }
    spareSize = it->first;
    name = it->second;
    m_spares.erase(it);
    return true;
}

int DurableDirectory::openForWriting(Prepared& prepared, std::size_t size, std::size_t& oldSize) {
    if (takeSpare(size, prepared.tempName, oldSize)) {
        const int fd = ::openat(m_dirFd, prepared.tempName.c_str(), O_WRONLY | O_CLOEXEC);
        if (fd >= 0) {
            return fd;
        }
        ::unlinkat(m_dirFd, prepared.tempName.c_str(), 0);
    }
    oldSize = 0;
    prepared.tempName = std::string(kTempPrefix) + std::to_string(::getpid()) + "_" +
                        std::to_string(++m_tempCounter);
    return ::openat(m_dirFd, prepared.tempName.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC,
                    0600);
}

DurableDirectory::Prepared DurableDirectory::prepare(const std::vector<Part>& parts) {
    std::size_t size = 0;
    for (const Part& part : parts) {
        size += part.size;
    }
    Prepared prepared;
    std::size_t oldSize = 0;
    const int fd = openForWriting(prepared, size, oldSize);
    if (fd < 0) {
        throw systemError("cannot create temporary file in", m_path);
    }
    // A spare is overwritten from its start; only a change of size touches its metadata.
    const bool ok = writeAll(fd, parts) &&
                    (oldSize <= size || ::ftruncate(fd, static_cast<off_t>(size)) == 0) &&
                    fsyncRetrying(fd, true) == 0;
    const int savedErrno = errno;
    ::close(fd);
    if (!ok) {
        discard(prepared);
        errno = savedErrno;
        throw systemError("cannot write temporary file in", m_path);
    }
    return prepared;
}

std::uint64_t DurableDirectory::commit(Prepared& prepared, const std::string& fileName) {
    const char* temp = prepared.tempName.c_str();
    int result = -1;
    if (m_exchangeWorks) {
        result = ::renameat2(m_dirFd, temp, m_dirFd, fileName.c_str(), RENAME_EXCHANGE);
        prepared.replacedOld = result == 0;
        if (result != 0 && (errno == EINVAL || errno == ENOSYS)) {
            m_exchangeWorks = false;
        }
    }
    if (result != 0) {
        result = ::renameat(m_dirFd, temp, m_dirFd, fileName.c_str());
    }
    if (result != 0) {
        const int savedErrno = errno;
        discard(prepared);
        errno = savedErrno;
        throw systemError("cannot rename into", m_path + "/" + fileName);
    }
    std::lock_guard<std::mutex> lock(m_syncMutex);
    return ++m_issued;
}

void DurableDirectory::recycle(const Prepared& prepared) {
    if (!prepared.replacedOld) {
        return;
    }
    struct stat status {};
    std::lock_guard<std::mutex> lock(m_spareMutex);
    if (m_spares.size() >= kMaxSpares ||
        ::fstatat(m_dirFd, prepared.tempName.c_str(), &status, 0) != 0) {
        ::unlinkat(m_dirFd, prepared.tempName.c_str(), 0);
        return;
    }
    m_spares.emplace(static_cast<std::size_t>(status.st_size), prepared.tempName);
}

std::uint64_t DurableDirectory::remove(const std::string& fileName) {
    if (::unlinkat(m_dirFd, fileName.c_str(), 0) != 0 && errno != ENOENT) {
        throw systemError("cannot remove", m_path + "/" + fileName);
    }
    std::lock_guard<std::mutex> lock(m_syncMutex);
    return ++m_issued;
}

void DurableDirectory::discard(const Prepared& prepared) {
    ::unlinkat(m_dirFd, prepared.tempName.c_str(), 0);
}

void DurableDirectory::syncThrough(std::uint64_t ticket) {
    std::unique_lock<std::mutex> lock(m_syncMutex);
    while (m_synced < ticket) {
        if (m_syncing) {
            m_syncDone.wait(lock);
            continue;
        }
        // This thread syncs for every change issued so far, its own included.
        m_syncing = true;
        const std::uint64_t target = m_issued;
        lock.unlock();
        const int result = fsyncRetrying(m_dirFd, false);
        const int savedErrno = errno;
        lock.lock();
        m_syncing = false;
        if (result == 0 && target > m_synced) {
            m_synced = target;
        }
        m_syncDone.notify_all();
        if (result != 0) {
            errno = savedErrno;
            throw systemError("cannot sync directory", m_path);
        }
    }
}

void DurableDirectory::writeFile(const std::string& fileName, const std::vector<Part>& parts) {
    Prepared prepared = prepare(parts);
    syncThrough(commit(prepared, fileName));
    recycle(prepared);
}

std::vector<std::string> DurableDirectory::entries() const {
    std::vector<std::string> names;
    DIR* dir = ::opendir(m_path.c_str());
    if (dir == nullptr) {
        throw systemError("cannot list", m_path);
    }
    while (const dirent* entry = ::readdir(dir)) {
        const std::string name = entry->d_name;
        if (name != "." && name != "..") {
            names.push_back(name);
        }
    }
    ::closedir(dir);
    return names;
}

bool DurableDirectory::readFile(const std::string& fileName, std::string& content) const {
    const int fd = ::openat(m_dirFd, fileName.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) {
        return false;
    }
    content.clear();
    char buf[65536];
    bool ok = true;
    for (;;) {
        const ssize_t got = ::read(fd, buf, sizeof buf);
        if (got < 0 && errno == EINTR) {
            continue;
        }
        if (got <= 0) {
            ok = got == 0;
            break;
        }
        content.append(buf, static_cast<std::size_t>(got));
    }
    ::close(fd);
    return ok;
}

}  // namespace Configuration
