#include "tests/helpers/failing_allocations.h"

#include <cstddef>
#include <cstdint>
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

// The linker's names for a function, and for what calls to it become. Those of operator new depend
// on what size_t is. NOLINTBEGIN
#if SIZE_MAX == UINT32_MAX
#define REAL(what) __real__##what##jRKSt9nothrow_t
#define WRAP(what) __wrap__##what##jRKSt9nothrow_t
#else
#define REAL(what) __real__##what##mRKSt9nothrow_t
#define WRAP(what) __wrap__##what##mRKSt9nothrow_t
#endif
extern "C" {

void* REAL(Znw)(size_t size, const std::nothrow_t& tag);
void* WRAP(Znw)(size_t size, const std::nothrow_t& tag);
void* REAL(Zna)(size_t size, const std::nothrow_t& tag);
void* WRAP(Zna)(size_t size, const std::nothrow_t& tag);
void* __real_calloc(size_t count, size_t size);
void* __wrap_calloc(size_t count, size_t size);
void* __real_malloc(size_t size);
void* __wrap_malloc(size_t size);
void* __real_realloc(void* block, size_t size);
void* __wrap_realloc(void* block, size_t size);
void __real_free(void* block);
void __wrap_free(void* block);
// NOLINTEND

void* WRAP(Znw)(size_t size, const std::nothrow_t& tag) {
    return fails(size) ? nullptr : REAL(Znw)(size, tag);
}

void* WRAP(Zna)(size_t size, const std::nothrow_t& tag) {
    return fails(size) ? nullptr : REAL(Zna)(size, tag);
}

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

// Under the sanitizers, sizes that no machine has yield null too instead of ending the program.
// NOLINTBEGIN: their names
const char* __asan_default_options();
const char* __asan_default_options() { return "allocator_may_return_null=1"; }
const char* __msan_default_options();
const char* __msan_default_options() { return "allocator_may_return_null=1"; }
// NOLINTEND

}  // extern "C"
