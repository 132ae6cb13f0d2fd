// The library's own operator new and delete, hidden inside it. The C++ runtime's would bring the
// machinery of exceptions along, more code than the rest, to throw what nobody throws here.

#include <cstdlib>
#include <new>

void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    return std::malloc(size > 0 ? size : 1);
}
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept {
    return std::malloc(size > 0 ? size : 1);
}

// Without the forms of new that throw, which nothing here calls.
// NOLINTBEGIN(misc-new-delete-overloads)
void operator delete(void* block) noexcept { std::free(block); }
void operator delete(void* block, std::size_t) noexcept { std::free(block); }
void operator delete[](void* block) noexcept { std::free(block); }
// NOLINTEND(misc-new-delete-overloads)
