#pragma once

#include <cstddef>

namespace ardcard {

// Maps in the whole pages of [begin, begin + bytes) ready for writing, in one
// call. A large read fills hundreds of megabytes of fresh memory; faulting it
// in page by page as the rows arrive costs far more, on a virtual machine
// above all. Where the system cannot do it, the pages fault in on first write
// as usual.
void PrefaultForWrite(void* begin, std::size_t bytes);

} // namespace ardcard
