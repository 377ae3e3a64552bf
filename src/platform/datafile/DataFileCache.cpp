#include "DataFileCache.h"
#include "fileio/GuardedFile.h"

#include <map>
#include <mutex>

namespace datafile {

namespace {

struct Entry {
    fileio::FileIdentity identity;
    std::shared_ptr<const HeaderResult> result;
};

// A bound on the entries, so that a program that looks at many files does not grow without
// end; a full cache simply starts again.
constexpr std::size_t kMaxEntries = 512;

std::mutex g_mutex;
std::map<std::string, Entry> g_cache;
std::uint64_t g_reads = 0;

}  // namespace

std::shared_ptr<const HeaderResult> CachedHeader(const std::string& path) {
    // A file replaced by another of the same size and time is told by its inode.
    const fileio::FileIdentity identity = fileio::IdentityOf(path);
    if (!identity.Known()) {
        std::lock_guard lock(g_mutex);
        g_cache.erase(path);
        ++g_reads;
        return std::make_shared<const HeaderResult>(ReadHeader(path));
    }
    {
        std::lock_guard lock(g_mutex);
        const auto it = g_cache.find(path);
        if (it != g_cache.end() && it->second.identity == identity)
            return it->second.result;
    }
    auto result = std::make_shared<const HeaderResult>(ReadHeader(path));
    std::lock_guard lock(g_mutex);
    ++g_reads;
    // A file that could not be opened (line 0) may be readable on the next try.
    if (result->error && result->error->line == 0) {
        g_cache.erase(path);
        return result;
    }
    if (g_cache.size() >= kMaxEntries)
        g_cache.clear();
    g_cache[path] = Entry{identity, result};
    return result;
}

std::uint64_t HeaderReadCount() {
    std::lock_guard lock(g_mutex);
    return g_reads;
}

void ClearHeaderCache() {
    std::lock_guard lock(g_mutex);
    g_cache.clear();
}

}  // namespace datafile
