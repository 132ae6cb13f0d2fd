#include "tests/differential/placed_vector.h"

#include <sys/mman.h>
#include <unistd.h>

#include <map>
#include <new>
#include <unordered_map>

namespace {

int current_placement = HEAP;

// Pages that may be used, between two that may not.
struct block {
    unsigned char* inside;
    size_t size;
};

std::multimap<size_t, block> unused;            // by size: mapping anew for each case is slow
std::unordered_map<const void*, block> in_use;  // by the address handed out

size_t page_size() {
    static const auto size = static_cast<size_t>(sysconf(_SC_PAGESIZE));
    return size;
}

block map_block(size_t size) {
    void* const pages =
        mmap(nullptr, size + 2 * page_size(), PROT_NONE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (pages == MAP_FAILED) throw std::bad_alloc();
    unsigned char* const inside = static_cast<unsigned char*>(pages) + page_size();
    if (mprotect(inside, size, PROT_READ | PROT_WRITE) != 0) throw std::bad_alloc();
    return {inside, size};
}

block take_block(size_t size) {
    const auto found = unused.find(size);
    if (found == unused.end()) return map_block(size);
    const block taken = found->second;
    unused.erase(found);
    return taken;
}

}  // namespace

void set_placement(int placement) { current_placement = placement; }

void* allocate_placed(size_t bytes, size_t alignment) {
    if (current_placement == HEAP) return operator new(bytes);
    const size_t pages = (bytes + UNMAPPED_END + page_size() - 1) / page_size();
    const block b = take_block(pages * page_size());
    unsigned char* const place =
        current_placement == UNMAPPED_END
            ? b.inside + b.size - bytes
            : b.inside + static_cast<size_t>(current_placement) / alignment * alignment;
    in_use.emplace(place, b);
    return place;
}

void free_placed(void* place) {
    const auto found = in_use.find(place);
    if (found == in_use.end()) {
        operator delete(place);
        return;
    }
    unused.emplace(found->second.size, found->second);
    in_use.erase(found);
}
