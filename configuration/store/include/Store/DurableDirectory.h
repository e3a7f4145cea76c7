// DurableDirectory: one directory whose files are replaced atomically and durably. The directory
// is held exclusively through flock on its "___lock___" file for the object's lifetime, so two
// processes cannot share it. A file is written under a temporary name (".__temp__<n>"), flushed
// with fdatasync, moved over its final name and made durable by an fsync of the directory;
// directory fsyncs are shared by the writers waiting at the same time (group commit). A kill at
// any moment leaves either the old or the new file, never a torn one; leftovers of temporary
// files are removed when the directory is opened.
//
// Replacing swaps the two names atomically (renameat2 RENAME_EXCHANGE), so the temporary name
// then holds the replaced file. Once that swap is on disk, recycle() keeps it as a spare that a
// later prepare() overwrites in place: no inode is created or freed, and a spare of the same size
// is flushed without a journal commit. Spares are temporary files like any other. All calls are
// thread-safe.
#pragma once

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <map>
#include <mutex>
#include <string>
#include <vector>

namespace Configuration {

class DurableDirectory {
public:
    // A byte range to be written.
    struct Part {
        const void* data;
        std::size_t size;
    };

    // A written and flushed temporary file, not yet renamed to its final name.
    struct Prepared {
        std::string tempName;
        bool replacedOld = false;  // commit() swapped it with the file it replaced
    };

    static constexpr const char* kLockName = "___lock___";
    static constexpr const char* kTempPrefix = ".__temp__";

    // Opens (creating if missing) the directory, locks it and removes stale temporary files.
    // Throws std::runtime_error when the directory cannot be used or is locked by another owner.
    explicit DurableDirectory(const std::string& path);
    ~DurableDirectory();
    DurableDirectory(const DurableDirectory&) = delete;
    DurableDirectory& operator=(const DurableDirectory&) = delete;

    const std::string& path() const { return m_path; }

    // Writes the parts to a new temporary file and flushes it to disk; throws on failure.
    Prepared prepare(const std::vector<Part>& parts);
    // Moves a prepared file over fileName; returns the ticket to pass to syncThrough().
    std::uint64_t commit(Prepared& prepared, const std::string& fileName);
    // After syncThrough() of its commit: keeps the replaced file as a spare for prepare().
    void recycle(const Prepared& prepared);
    // Removes fileName (absent is fine); returns the ticket to pass to syncThrough().
    std::uint64_t remove(const std::string& fileName);
    // Drops a prepared file that will not be committed.
    void discard(const Prepared& prepared);
    // Returns once every rename or removal up to ticket is on disk; throws on failure.
    void syncThrough(std::uint64_t ticket);
    // prepare + commit + syncThrough in one call.
    void writeFile(const std::string& fileName, const std::vector<Part>& parts);

    // The names of the directory's entries (no "." or "..").
    std::vector<std::string> entries() const;
    // Reads a whole file; false when it cannot be read.
    bool readFile(const std::string& fileName, std::string& content) const;

private:
    static constexpr std::size_t kMaxSpares = 64;

    void lockDirectory();
    void removeTemporaries();
    // A spare's name and size, preferring one of the given size; false when there is none.
    bool takeSpare(std::size_t size, std::string& name, std::size_t& spareSize);
    int openForWriting(Prepared& prepared, std::size_t size, std::size_t& oldSize);

    std::string m_path;
    int m_dirFd = -1;
    int m_lockFd = -1;
    std::atomic<std::uint64_t> m_tempCounter{0};
    std::atomic<bool> m_exchangeWorks{true};  // false on file systems without RENAME_EXCHANGE

    std::mutex m_spareMutex;
    std::multimap<std::size_t, std::string> m_spares;  // size to temporary file name

    std::mutex m_syncMutex;
    std::condition_variable m_syncDone;
    std::uint64_t m_issued = 0;  // changes of the directory made so far
    std::uint64_t m_synced = 0;  // changes known to be on disk
    bool m_syncing = false;
};

}  // namespace Configuration
