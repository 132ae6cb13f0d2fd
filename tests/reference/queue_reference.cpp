#include "tests/reference/queue_reference.h"

#include <cstddef>
#include <set>

namespace reference {

queue::queue(std::vector<node>& pool)
    : head(NO_NODE), tail(NO_NODE), count(0), spare(0), step(100), rings(0), nodes(pool) {
    index.fill(NO_NODE);
}

// NO_NODE turns into the largest size_t, which no pool has.
node& queue::at(int n) { return nodes.at(static_cast<std::size_t>(n)); }

bool queue::empty() const { return head == NO_NODE || count == 0; }

// False, with nothing written, when p is not the head and yet has nobody in front of it.
bool queue::insert_before(int p, int n) {
    if (p == head) {
        at(p).prev = n;
        at(n).next = p;
        head = n;
        return true;  // n keeps the prev that it came with
    }
    const int q = at(p).prev;
    if (q == NO_NODE) return false;
    at(q).next = n;
    at(n).prev = q;
    at(n).next = p;
    at(p).prev = n;
    return true;
}

void queue::append(int last, int n) {
    at(last).next = n;
    at(n).prev = last;
    at(n).next = NO_NODE;
    tail = n;
}

int queue::push_indexed(int n) {
    const int c = at(n).cost;
    int anchor = head;
    std::size_t k = 0;
    for (; k < 100; ++k) {
        const int e = index.at(k);
        if (e == NO_NODE) break;
        if (at(e).cost >= c) break;
        anchor = e;
    }
    // From the first entry that does not stay in front of n, if there is one, up to the first null.
    for (; k < 100; ++k) {
        const int e = index.at(k);
        if (e == NO_NODE) break;
        index.at(k) = at(e).prev;
    }

    if (c <= at(anchor).cost) return insert_before(anchor, n) ? 1 : 0;

    std::set<int> seen;
    int v = anchor;
    while (at(v).cost < c) {
        if (!seen.insert(v).second) {
            ++rings;
            head = NO_NODE;
            tail = NO_NODE;
            count = 0;
            return 0;
        }
        if (at(v).next == NO_NODE) {
            append(v, n);
            return 1;
        }
        v = at(v).next;
    }
    return insert_before(v, n) ? 1 : 0;
}

int queue::push_linear(int n) {
    const int c = at(n).cost;
    const int queued = count;
    int v = head;
    int i = 0;
    while (i < queued) {
        if (at(v).cost > c && i == 0) {
            // The walk stays on v, so with two or more queued the next turn inserts n before v
            // again, behind itself.
            at(v).prev = n;
            at(n).next = v;
            head = n;
        } else if (at(v).cost > c) {
            return insert_before(v, n) ? 1 : 0;
        } else if (at(v).next == NO_NODE) {
            append(v, n);
            return 1;
        } else {
            v = at(v).next;
        }
        ++i;
    }
    return 1;
}

int queue::push(int n) {
    if (head == NO_NODE) {
        head = n;
        tail = n;
        at(n).prev = NO_NODE;
        at(n).next = NO_NODE;
    } else if (count > step) {
        if (push_indexed(n) == 0) return 0;
    } else if (count >= 1) {
        if (push_linear(n) == 0) return 0;
    }
    // Nothing is linked when the list has a head and a count of 0 or less, but n is counted.

    ++count;
    if (count % step == 0) {
        const int k = count / step - 1;
        if (0 <= k && k <= 99) index.at(static_cast<std::size_t>(k)) = tail;
    }
    return 1;
}

int queue::pop() {
    const int h = head;
    head = at(h).next;
    if (head != NO_NODE) at(head).prev = NO_NODE;
    for (int& entry : index) {
        if (entry == NO_NODE) break;
        entry = at(entry).next;
    }
    --count;
    if (count < 0) count = 0;
    return h;
}

}  // namespace reference
