// Vectors whose place in memory is chosen: any alignment, or the last element just before a page
// that may be neither read nor written. No result of the library may depend on it.
#pragma once

#include <cstddef>
#include <vector>

// Where the vectors allocated from now on begin or end.
//
//   0 .. 15     that many bytes behind an unmapped page, less what the element type cannot have
//   UNMAPPED_END  they end at an unmapped page
//   HEAP        wherever operator new puts them, which is what the sanitizers watch best
constexpr int UNMAPPED_END = 16;
constexpr int PLACEMENTS = 17;
constexpr int HEAP = 17;

void set_placement(int placement);

void* allocate_placed(size_t bytes, size_t alignment);
void free_placed(void* place);

template <class T>
struct placing_allocator {
    using value_type = T;

    placing_allocator() = default;
    template <class U>
    placing_allocator(const placing_allocator<U>&) {}

    T* allocate(size_t count) {
        return static_cast<T*>(allocate_placed(count * sizeof(T), alignof(T)));
    }
    void deallocate(T* place, size_t) { free_placed(place); }

    bool operator==(const placing_allocator&) const { return true; }
    bool operator!=(const placing_allocator&) const { return false; }
};

template <class T>
class placed_vector : public std::vector<T, placing_allocator<T>> {
public:
    using std::vector<T, placing_allocator<T>>::vector;
    template <class U>
    explicit placed_vector(const std::vector<U>& values)
        : placed_vector(values.begin(), values.end()) {}
};
