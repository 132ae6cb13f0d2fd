// Counts the library's allocations, and makes it run out of memory at a chosen one.
//
// The test program is linked so that the library's calls of operator new(nothrow) and
// new[](nothrow), which the engine's buffers come from, of calloc, which the region passes' work
// buffers come from, and of malloc, realloc and free pass by here. All count in one row; what the
// C++ library's own binary allocates is left alone.
#pragma once

#include <cstddef>

class failing_allocations {
public:
    enum extent { ONCE, FROM_THEN_ON };

    // While this object lives, the nth allocation (the first is 1) yields null, and with
    // FROM_THEN_ON so does every later one. With 0 they are only counted. One object at a time.
    explicit failing_allocations(int nth, extent how_long = ONCE);
    ~failing_allocations();
    failing_allocations(const failing_allocations&) = delete;
    failing_allocations& operator=(const failing_allocations&) = delete;

    // Allocations asked for since this object was made, those that failed included.
    int asked() const;

    // Blocks given to free since then, null ones left out.
    int freed() const;

    // Bytes that they asked for, all in all.
    size_t bytes() const;
};
