#include <memory>

#include "selection/D_Queue.h"
#include "tests/differential/family.h"
#include "tests/reference/queue_reference.h"

namespace {

// A queue of the library and one of the model, over pools with the same records.
class queue_pair {
public:
    queue_pair(int nodes, int step, findings* f)
        : found(f), records(static_cast<size_t>(nodes)), model(model_records) {
        library.step = model.step = step;
        for (node& n : records) n = {0, 0, 0, 0, nullptr, nullptr};
        model_records.assign(static_cast<size_t>(nodes),
                             {0, 0, 0, 0, reference::NO_NODE, reference::NO_NODE});
    }

    void push(int n, int cost) {
        records[static_cast<size_t>(n)].cost = cost;
        model_records[static_cast<size_t>(n)].cost = cost;
        found->compare("push", library.push(&records[static_cast<size_t>(n)]), model.push(n));
        compare();
    }

    void pop() {
        found->compare("empty", library.empty(), model.empty());
        if (model.head == reference::NO_NODE || !found->agree()) return;
        found->compare("pop", number(library.pop()), model.pop());
        compare();
    }

    void reset_counts() {
        library.count = model.count = 0;
        for (int k = 0; k < QUEUE_INDEX_ENTRIES; ++k) library.index[k] = nullptr;
        model.index.fill(reference::NO_NODE);
    }

    // Takes n out of the list without telling the index, as a stroke does.
    void unlink(int n) {
        node& m = records[static_cast<size_t>(n)];
        if (m.next) m.next->prev = m.prev;
        if (m.prev) m.prev->next = m.next;
        --library.count;
        reference::node& r = model_records[static_cast<size_t>(n)];
        if (r.next >= 0) model_records[static_cast<size_t>(r.next)].prev = r.prev;
        if (r.prev >= 0) model_records[static_cast<size_t>(r.prev)].next = r.next;
        --model.count;
    }

    int rings() const { return model.rings; }

private:
    int number(const node* n) const {
        return n ? static_cast<int>(n - records.data()) : reference::NO_NODE;
    }

    void compare() const {
        found->compare("count", library.count, model.count);
        found->compare("head", number(library.head), model.head);
        found->compare("tail", number(library.tail), model.tail);
        for (size_t k = 0; k < model.index.size(); ++k) {
            found->compare("index entry", number(library.index[k]), model.index[k]);
        }
        for (size_t n = 0; n < records.size(); ++n) {
            found->compare("prev", number(records[n].prev), model_records[n].prev);
            found->compare("next", number(records[n].next), model_records[n].next);
        }
    }

    findings* found;
    std::vector<node> records;
    std::vector<reference::node> model_records;
    D_Queue library;
    reference::queue model;
};

// Pushes, pops, unlinks and resets on a few nodes, which are pushed again while they are queued, so
// that lists break and close into rings.
void run_queue(random_source& random, findings* found) {
    const int nodes = random.size_up_to(60);
    queue_pair queues(nodes, random.size_up_to(12), found);
    const int most_cost = random.any_of({1, 5, 100});
    const bool disciplined = random.one_in(2);  // each node is pushed once
    int fresh = 0;
    for (int calls = random.between(1, 150); calls > 0 && found->agree(); --calls) {
        const int kind = random.between(0, 9);
        if (kind < 6) {
            const int n = disciplined ? fresh++ : random.between(0, nodes - 1);
            if (n >= nodes) break;
            queues.push(n, random.between(0, most_cost));
        } else if (kind < 8) {
            queues.pop();
        } else if (!disciplined) {
            if (random.one_in(20)) {
                queues.reset_counts();
            } else {
                queues.unlink(random.between(0, nodes - 1));
            }
        }
    }
    if (queues.rings() > 0) found->count("cases with a ring found");
}

}  // namespace

const std::vector<family> queue_families = {
    {"queue", "pushes, pops and unlinked nodes on one queue", 60000, run_queue},
};
