#include "tests/helpers/failing_allocations.h"

#include <cstddef>
#include <cstdlib>
#include <new>
#include <stdexcept>

namespace {

struct {
    bool active;
    int nth;
    failing_allocations::extent how_long;
    int asked;
    int freed;
    size_t bytes;
} plan;

// Counts one allocation; true when the plan wants it to fail.
bool fails(size_t bytes) {
    if (!plan.active) return false;
    ++plan.asked;
    plan.bytes += bytes;
    if (plan.nth == 0) return false;
    return plan.how_long == failing_allocations::ONCE ? plan.asked == plan.nth
                                                      : plan.asked >= plan.nth;
}

}  // namespace

failing_allocations::failing_allocations(int nth, extent how_long) {
    if (plan.active) throw std::logic_error("allocations fail by another plan already");
    plan = {true, nth, how_long, 0, 0, 0};
}

failing_allocations::~failing_allocations() { plan.active = false; }

int failing_allocations::asked() const { return plan.asked; }

int failing_allocations::freed() const { return plan.freed; }

size_t failing_allocations::bytes() const { return plan.bytes; }

// Through the throwing forms, so that the ordinary delete takes the memory back.
void* operator new(size_t size, const std::nothrow_t&) noexcept {
    if (fails(size)) return nullptr;
    try {
        return ::operator new(size);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

void* operator new[](size_t size, const std::nothrow_t&) noexcept {
    if (fails(size)) return nullptr;
    try {
        return ::operator new[](size);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

extern "C" {

// The linker's names for a function, and for what calls to it become. NOLINTBEGIN
void* __real_calloc(size_t count, size_t size);
void* __wrap_calloc(size_t count, size_t size);
void* __real_malloc(size_t size);
void* __wrap_malloc(size_t size);
void* __real_realloc(void* block, size_t size);
void* __wrap_realloc(void* block, size_t size);
void __real_free(void* block);
void __wrap_free(void* block);
// NOLINTEND

void* __wrap_calloc(size_t count, size_t size) {
    return fails(count * size) ? nullptr : __real_calloc(count, size);
}

void* __wrap_malloc(size_t size) { return fails(size) ? nullptr : __real_malloc(size); }

void* __wrap_realloc(void* block, size_t size) {
    return fails(size) ? nullptr : __real_realloc(block, size);
}

void __wrap_free(void* block) {
    if (plan.active && block) ++plan.freed;
    __real_free(block);
}

// Under AddressSanitizer, sizes that no machine has yield null too instead of ending the program.
const char* __asan_default_options();  // NOLINT: the sanitizer's name
const char* __asan_default_options() { return "allocator_may_return_null=1"; }

}  // extern "C"
