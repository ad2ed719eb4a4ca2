#include "common/prefault.h"

#include <cstdint>
#include <sys/mman.h>
#include <unistd.h>

namespace ardcard {

void PrefaultForWrite(void* begin, std::size_t bytes) {
#ifdef MADV_POPULATE_WRITE
    static const auto page = static_cast<std::uintptr_t>(sysconf(_SC_PAGESIZE));
    const auto from = reinterpret_cast<std::uintptr_t>(begin);
    // Whole pages only: the partial pages at the ends hold other data and
    // are mapped already.
    const std::uintptr_t first = (from + page - 1) & ~(page - 1);
    const std::uintptr_t last = (from + bytes) & ~(page - 1);
    if (last > first)
        madvise(reinterpret_cast<void*>(first), last - first, MADV_POPULATE_WRITE);
#else
    (void)begin;
    (void)bytes;
#endif
}

} // namespace ardcard
