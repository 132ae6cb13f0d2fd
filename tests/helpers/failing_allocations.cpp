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
} plan;

// Counts one allocation; true when the plan wants it to fail.
bool fails() {
    if (!plan.active) return false;
    ++plan.asked;
    if (plan.nth == 0) return false;
    return plan.how_long == failing_allocations::ONCE ? plan.asked == plan.nth
                                                      : plan.asked >= plan.nth;
}

}  // namespace

failing_allocations::failing_allocations(int nth, extent how_long) {
    if (plan.active) throw std::logic_error("allocations fail by another plan already");
    plan = {true, nth, how_long, 0};
}

failing_allocations::~failing_allocations() { plan.active = false; }

int failing_allocations::asked() const { return plan.asked; }

// Through the throwing forms, so that the ordinary delete takes the memory back.
void* operator new(size_t size, const std::nothrow_t&) noexcept {
    if (fails()) return nullptr;
    try {
        return ::operator new(size);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

void* operator new[](size_t size, const std::nothrow_t&) noexcept {
    if (fails()) return nullptr;
    try {
        return ::operator new[](size);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

extern "C" {

void* __real_calloc(size_t count, size_t size);  // NOLINT: the linker's name for calloc
void* __wrap_calloc(size_t count, size_t size);  // NOLINT: what the linker makes of calloc

void* __wrap_calloc(size_t count, size_t size) {
    return fails() ? nullptr : __real_calloc(count, size);
}

}  // extern "C"
