#include "selection/D_Queue.h"

#include <new>

#include "support/arithmetic.h"

namespace {

void append(D_Queue& queue, node* last, node* n) {
    last->next = n;
    n->prev = last;
    n->next = nullptr;
    queue.tail = n;
}

// Links n before p. Returns false, with nothing changed, when p is not the head and has no `prev`.
bool insert_before(D_Queue& queue, node* p, node* n) {
    if (p == queue.head) {
        p->prev = n;
        n->next = p;
        queue.head = n;
        return true;
    }
    node* const q = p->prev;
    if (!q) return false;
    q->next = n;
    n->prev = q;
    n->next = p;
    p->prev = n;
    return true;
}

// The last index entry cheaper than `cost`, or the head. Moves every later entry one node towards
// the head, since a node of `cost` will land before them.
node* find_anchor(D_Queue& queue, int cost) {
    node* anchor = queue.head;
    node** entry = queue.index;
    node** const end = queue.index + QUEUE_INDEX_ENTRIES;
    for (; entry != end && *entry && (*entry)->cost < cost; ++entry) anchor = *entry;
    for (; entry != end && *entry; ++entry) *entry = (*entry)->prev;
    return anchor;
}

// The search with more than `step` nodes queued: n lands before its equals.
//
// The engine's unlinking can leave a popped node in the index, and a push through it can close the
// list into a ring. A walk that passes only cheaper nodes would then never end. It is found out by
// comparing each node with one met earlier, which moves up at every power of two (Brent's cycle
// detection): they are the same only when the walk has come back.
bool push_indexed(D_Queue& queue, node* n) {
    node* point = find_anchor(queue, n->cost);
    const node* met = nullptr;
    for (unsigned steps = 1, next_meeting = 1; point->cost < n->cost; ++steps) {
        if (!point->next) {
            append(queue, point, n);
            return true;
        }
        if (point == met) {
            queue.head = queue.tail = nullptr;
            queue.count = 0;
            return false;
        }
        if (steps == next_meeting) {
            met = point;
            next_meeting *= 2;
        }
        point = point->next;
    }
    return insert_before(queue, point, n);
}

// The search with at most `step` nodes queued: n lands behind its equals. It ends after `count`
// nodes, whatever the links say.
bool push_linear(D_Queue& queue, node* n) {
    node* v = queue.head;
    for (int i = 0; i < queue.count; ++i) {
        if (v->cost > n->cost) {
            // Deliberate: a new head does not end the walk, which meets v again and finds n itself
            // as its `prev`; n->prev becomes n.
            if (i > 0) return insert_before(queue, v, n);
            v->prev = n;
            n->next = v;
            queue.head = n;
        } else if (v->next) {
            v = v->next;
        } else {
            append(queue, v, n);
            return true;
        }
    }
    return true;
}

}  // namespace

D_Queue::D_Queue()
    : head(nullptr),
      tail(nullptr),
      count(0),
      spare(0),
      index(new (std::nothrow) node*[QUEUE_INDEX_ENTRIES]()),
      step(100) {}

D_Queue::~D_Queue() {
    delete[] index;
    index = nullptr;
}

int D_Queue::push(node* n) {
    if (!head) {
        head = tail = n;
        n->prev = n->next = nullptr;
    } else if (count > step) {
        if (!push_indexed(*this, n)) return 0;
    } else if (count >= 1) {
        if (!push_linear(*this, n)) return 0;
    }
    count = wrap_add(count, 1);
    if (count % step == 0) {
        const int steps = count / step;
        if (steps >= 1 && steps <= QUEUE_INDEX_ENTRIES) index[steps - 1] = tail;
    }
    return 1;
}

node* D_Queue::pop() {
    node* const cheapest = head;
    head = cheapest->next;
    if (head) head->prev = nullptr;
    for (int k = 0; k < QUEUE_INDEX_ENTRIES && index[k]; ++k) index[k] = index[k]->next;
    count = count > 1 ? count - 1 : 0;
    return cheapest;
}

bool D_Queue::empty() { return !head || count == 0; }
