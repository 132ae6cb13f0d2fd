// Arrays of many gigabytes, all zero, of which only the touched pages take memory.
#pragma once

#include <sys/mman.h>

#include <cstddef>

// Why `data()` is null: to be said by a test that asserts it is not.
constexpr char NO_ROOM[] = "too little address space: call again after 'ulimit -v unlimited'";

template <class T>
class sparse_array {
public:
    // `data()` is null where the address space has no room for it, as on 32-bit machines.
    explicit sparse_array(unsigned long long count)
        : bytes(count * sizeof(T)), block(bytes > PTRDIFF_MAX ? MAP_FAILED : reserve(bytes)) {}
    ~sparse_array() {
        if (block != MAP_FAILED) munmap(block, static_cast<size_t>(bytes));
    }
    sparse_array(const sparse_array&) = delete;
    sparse_array& operator=(const sparse_array&) = delete;

    T* data() { return block == MAP_FAILED ? nullptr : static_cast<T*>(block); }
    T& operator[](unsigned long long i) { return data()[i]; }

private:
    static void* reserve(unsigned long long size) {
        return mmap(nullptr, static_cast<size_t>(size), PROT_READ | PROT_WRITE,
                    MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0);
    }

    const unsigned long long bytes;
    void* const block;
};
