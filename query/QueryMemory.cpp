#include "query/QueryMemory.h"

#include <cstdlib>
#include <malloc.h>
#include <mutex>
#include <sqlite3.h>

namespace pallax {

namespace {

constexpr sqlite3_int64 kMostMemory = sqlite3_int64{256} << 20U;

int roundUp(int size) {
    constexpr int kAlignment = 8;
    return (size + kAlignment - 1) / kAlignment * kAlignment;
}

void countWholeBlocks() {
    // NOLINTBEGIN(cppcoreguidelines-no-malloc): malloc_usable_size() is for these.
    sqlite3_mem_methods methods{};
    methods.xMalloc = [](int size) { return std::malloc(static_cast<std::size_t>(size)); };
    methods.xFree = std::free;
    methods.xRealloc = [](void* block, int size) {
        return std::realloc(block, static_cast<std::size_t>(size));
    };
    methods.xSize = [](void* block) { return static_cast<int>(::malloc_usable_size(block)); };
    // NOLINTEND(cppcoreguidelines-no-malloc)
    methods.xRoundup = roundUp;
    methods.xInit = [](void*) { return SQLITE_OK; };
    methods.xShutdown = [](void*) {};
    // Refused if something else has opened a connection; the limit then counts what is asked for.
    (void)sqlite3_config(SQLITE_CONFIG_MALLOC, &methods);
}

} // namespace

void limitQueryMemory() {
    static std::once_flag once;
    std::call_once(once, countWholeBlocks);
    sqlite3_hard_heap_limit64(kMostMemory);
}

} // namespace pallax
