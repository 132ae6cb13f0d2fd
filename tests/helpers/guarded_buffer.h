// Arrays whose surroundings cannot be touched: a read or write beyond one ends the test program.
#pragma once

#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <cstddef>
#include <new>
#include <vector>

// Which end of the array touches an unmapped page. So does the other end, up to a page away.
enum class guard { BEFORE, BEHIND };

// A copy of some values between two pages that may be neither read nor written.
template <class T>
class guarded_buffer {
public:
    guarded_buffer(const std::vector<T>& values, guard side)
        : count(values.size()),
          page(static_cast<size_t>(sysconf(_SC_PAGESIZE))),
          inside((count * sizeof(T) + page - 1) / page * page),
          pages(mmap(nullptr, inside + 2 * page, PROT_NONE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0)) {
        if (pages == MAP_FAILED) throw std::bad_alloc();
        unsigned char* const opened = static_cast<unsigned char*>(pages) + page;
        if (inside > 0 && mprotect(opened, inside, PROT_READ | PROT_WRITE) != 0) {
            munmap(pages, inside + 2 * page);
            throw std::bad_alloc();
        }
        const size_t gap = side == guard::BEHIND ? inside - count * sizeof(T) : 0;
        first = reinterpret_cast<T*>(opened + gap);
        std::copy(values.begin(), values.end(), first);
    }
    ~guarded_buffer() { munmap(pages, inside + 2 * page); }
    guarded_buffer(const guarded_buffer&) = delete;
    guarded_buffer& operator=(const guarded_buffer&) = delete;

    T* data() { return first; }
    std::vector<T> values() const { return std::vector<T>(first, first + count); }

private:
    const size_t count;
    const size_t page;
    const size_t inside;  // bytes of the pages between
    void* const pages;
    T* first;
};
