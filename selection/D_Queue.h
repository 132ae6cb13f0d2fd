// Priority queue of the selection engine.
#pragma once

#include <cstddef>

#include "support/ze_api.h"

// A pixel that a front has reached.
struct node {
    int x;       // pixel column in the image
    int y;       // pixel row in the image
    int cost;    // accumulated path cost; the priority, smaller first
    int label;   // 1: reached from the brush core, 0: reached from the rim
    node* prev;  // the node before it in the queue
    node* next;  // the node behind it
};
static_assert(offsetof(node, cost) == 2 * sizeof(int) && offsetof(node, prev) == 4 * sizeof(int) &&
                  sizeof(node) == 4 * sizeof(int) + 2 * sizeof(node*),
              "callers lay the node out as x, y, cost, label, prev, next");

constexpr int QUEUE_INDEX_ENTRIES = 100;  // pointers into the list

// One doubly linked list, cheapest node first, and an index of 100 pointers into it, `step` nodes
// apart, so that push need not walk from the head. The queue owns the index, never a node.
//
// The index is a hint: the engine unlinks nodes without telling it, so entries drift. push and pop
// work with a stale entry; nothing repairs it.
class ZE_API D_Queue {
public:
    // An empty queue with `step` 100. `index` is null when it cannot be allocated.
    D_Queue();
    ~D_Queue();
    D_Queue(const D_Queue&) = delete;
    D_Queue& operator=(const D_Queue&) = delete;

    // Queues n by n->cost. Returns 1, or 0 when the list turns out to be broken:
    //
    // - the insertion point is not the head and yet has no `prev`: `count` and n stay as they are;
    // - the list has been closed into a ring that the search would walk for ever: the list is
    //   dropped (no head, no tail, `count` 0) and n stays as it is.
    //
    // REQUIRES: `index` is not null, `step` >= 1.
    //
    // Deliberate: with at most `step` nodes queued, n goes behind its equals; with more, in front
    // of them. A new head keeps its old `prev`, and among two or more nodes and at most `step` even
    // gets itself as `prev`; pop clears the `prev` of each new head, and nothing reads a head's.
    // With a head but `count` <= 0, n is counted and not linked. `count` wraps.
    int push(node* n);

    // Removes and returns the cheapest node, its links as they were. REQUIRES: `head` and `index`
    // are not null. `count` stops at 0.
    //
    // Deliberate: `tail` stays as it is, also when the list becomes empty.
    node* pop();

    // True with no head, or with `count` 0.
    bool empty();

    // Public, in a fixed order: the engine resets and unlinks directly.
    node* head;    // cheapest, or null
    node* tail;    // dearest; stale when the list is empty
    int count;     // nodes believed queued
    int spare;     // zeroed here and by each growing stroke; nothing reads it
    node** index;  // owned; entry k marks position (k + 1) * step from 1; the first null ends it
    int step;      // nodes per index entry
};
