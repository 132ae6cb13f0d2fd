// Slow model of the engine's priority queue. The library is compared with it, field for field.
//
// Nodes are numbers into a vector that the caller owns, so a link that leads nowhere throws instead
// of reading foreign memory. Every index entry, link and count goes the way of the library's queue,
// also once they are stale or contradict each other: only then do two runs stay equal for long.
#pragma once

#include <array>
#include <vector>

namespace reference {

constexpr int NO_NODE = -1;

struct node {
    int x, y, cost, label;
    int prev, next;  // numbers into the pool, NO_NODE for null
};

class queue {
public:
    // The pool must outlive the queue; it may grow while the queue holds nodes of it.
    explicit queue(std::vector<node>& pool);

    // 1, or 0 when the list turned out to be broken or to be a ring.
    int push(int n);

    // Throws std::out_of_range when there is no head.
    int pop();

    bool empty() const;

    int head;
    int tail;
    int count;
    int spare;
    std::array<int, 100> index;
    int step;

    // Not a field of the library's queue: pushes that found a ring.
    int rings;

private:
    node& at(int n);
    bool insert_before(int p, int n);
    void append(int last, int n);
    int push_indexed(int n);
    int push_linear(int n);

    std::vector<node>& nodes;
};

}  // namespace reference
