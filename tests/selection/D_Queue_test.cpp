#include "selection/D_Queue.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <climits>
#include <deque>
#include <vector>

using ::testing::ElementsAre;
using ::testing::IsNull;

namespace {

node with_cost(int cost) { return {0, 0, cost, 0, nullptr, nullptr}; }

// The nodes from the head on.
std::vector<const node*> listed(const D_Queue& q) {
    std::vector<const node*> nodes;
    for (const node* n = q.head; n && nodes.size() < 1000; n = n->next) nodes.push_back(n);
    return nodes;
}

std::vector<int> costs(const D_Queue& q) {
    std::vector<int> all;
    for (const node* n : listed(q)) all.push_back(n->cost);
    return all;
}

// A queue of bucket width `step` with nodes that outlive it.
struct filled_queue {
    explicit filled_queue(int step, const std::vector<int>& costs_in_order = {}) {
        q.step = step;
        for (const int cost : costs_in_order) push(cost);
    }
    node* push(int cost) {
        nodes.push_back(with_cost(cost));
        EXPECT_EQ(q.push(&nodes.back()), 1);
        return &nodes.back();
    }
    node* operator[](size_t i) { return &nodes[i]; }

    std::deque<node> nodes;
    D_Queue q;
};

// A list linked by hand, cheapest first and with everything in order. The caller breaks it.
struct linked_queue {
    linked_queue(int step, const std::vector<int>& costs_in_order) {
        for (const int cost : costs_in_order) nodes.push_back(with_cost(cost));
        for (size_t i = 1; i < nodes.size(); ++i) {
            nodes[i - 1].next = &nodes[i];
            nodes[i].prev = &nodes[i - 1];
        }
        q.head = &nodes.front();
        q.tail = &nodes.back();
        q.count = static_cast<int>(nodes.size());
        q.step = step;
    }
    node* operator[](size_t i) { return &nodes[i]; }

    std::deque<node> nodes;
    D_Queue q;
};

// Puts a queue's index into the middle of a longer array for as long as this object lives.
class index_inside_an_array {
public:
    explicit index_inside_an_array(D_Queue* queue) : q(*queue), own(queue->index) {
        q.index = array + MARGIN;
    }
    ~index_inside_an_array() { q.index = own; }
    index_inside_an_array(const index_inside_an_array&) = delete;
    index_inside_an_array& operator=(const index_inside_an_array&) = delete;

    // Nothing has been written before or behind the index.
    bool is_untouched() const {
        for (int i = 0; i < MARGIN; ++i) {
            if (array[i] || array[MARGIN + 100 + i]) return false;
        }
        return true;
    }

private:
    static constexpr int MARGIN = 10;

    D_Queue& q;
    node** const own;
    node* array[MARGIN + 100 + MARGIN] = {};
};

}  // namespace

TEST(D_Queue, StartsEmptyWithBucketsOf100) {
    const D_Queue q;
    EXPECT_EQ(q.head, nullptr);
    EXPECT_EQ(q.tail, nullptr);
    EXPECT_EQ(q.count, 0);
    EXPECT_EQ(q.spare, 0);
    EXPECT_EQ(q.step, 100);
    ASSERT_NE(q.index, nullptr);
    for (int k = 0; k < 100; ++k) EXPECT_EQ(q.index[k], nullptr) << k;
}

TEST(D_Queue_empty, IsTrueWithoutAHeadOrWithCountZero) {
    D_Queue q;
    node n = with_cost(1);
    EXPECT_TRUE(q.empty());
    q.head = &n;
    EXPECT_TRUE(q.empty());
    q.count = 1;
    EXPECT_FALSE(q.empty());
    q.count = -1;
    EXPECT_FALSE(q.empty());
    q.head = nullptr;
    EXPECT_TRUE(q.empty());
}

TEST(D_Queue_push, MakesTheFirstNodeHeadAndTailAndClearsItsLinks) {
    D_Queue q;
    node other = with_cost(0);
    node n = {7, 8, 9, 1, &other, &other};

    EXPECT_EQ(q.push(&n), 1);

    EXPECT_EQ(q.head, &n);
    EXPECT_EQ(q.tail, &n);
    EXPECT_EQ(n.prev, nullptr);
    EXPECT_EQ(n.next, nullptr);
    EXPECT_EQ(q.count, 1);
    EXPECT_EQ(n.x, 7);
    EXPECT_EQ(n.y, 8);
    EXPECT_EQ(n.cost, 9);
    EXPECT_EQ(n.label, 1);
}

TEST(D_Queue_push, OrdersByCostWhicheverSearchItUses) {
    for (const int step : {1, 2, 3, 13, 100}) {
        filled_queue f(step);
        unsigned random = 1;
        for (int i = 0; i < 300; ++i) {
            random = random * 1664525u + 1013904223u;
            f.push(static_cast<int>(random >> 20));  // with equal costs among them
        }
        EXPECT_EQ(f.q.count, 300);
        int popped = 0;
        for (int last = -1; !f.q.empty(); ++popped) {
            const int cost = f.q.pop()->cost;
            ASSERT_LE(last, cost) << "step " << step << ", node " << popped;
            last = cost;
        }
        EXPECT_EQ(popped, 300) << "step " << step;
    }
}

// ---- at most `step` nodes queued: the linear search

TEST(D_Queue_push, AppendsTheDearestAndMovesTheTail) {
    filled_queue f(100, {1, 2});
    node other = with_cost(0);
    node n = {0, 0, 3, 0, &other, &other};

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[1], &n));
    EXPECT_EQ(f.q.tail, &n);
    EXPECT_EQ(n.prev, f[1]);
    EXPECT_EQ(n.next, nullptr);
}

TEST(D_Queue_push, LinksBothWaysInTheMiddle) {
    filled_queue f(100, {1, 5, 3});

    EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[2], f[1]));
    EXPECT_EQ(f[2]->prev, f[0]);
    EXPECT_EQ(f[1]->prev, f[2]);
    EXPECT_EQ(f.q.tail, f[1]);
}

TEST(D_Queue_push, PutsANodeBehindItsEqualsUpToStepNodes) {
    filled_queue f(3, {5, 5, 5, 5});  // the last finds three queued, which is not above 3
    EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[1], f[2], f[3]));

    filled_queue middle(100, {1, 5, 9, 5});
    EXPECT_THAT(listed(middle.q), ElementsAre(middle[0], middle[1], middle[3], middle[2]));
}

TEST(D_Queue_push, LeavesThePrevOfANewHeadOverOneNodeAsItWas) {
    filled_queue f(100, {5});
    node other = with_cost(0);
    node n = {0, 0, 4, 0, &other, nullptr};

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_THAT(listed(f.q), ElementsAre(&n, f[0]));
    EXPECT_EQ(n.prev, &other);
    EXPECT_EQ(f[0]->prev, &n);
    EXPECT_EQ(f.q.tail, f[0]);
}

TEST(D_Queue_push, LeavesANewHeadOverTwoNodesAsItsOwnPrevUntilThePop) {
    filled_queue f(100, {5, 6});
    node* const n = f.push(4);

    EXPECT_EQ(f.q.head, n);
    EXPECT_EQ(n->prev, n);
    EXPECT_EQ(n->next, f[0]);
    EXPECT_EQ(f[0]->prev, n);
    EXPECT_THAT(listed(f.q), ElementsAre(n, f[0], f[1]));
    EXPECT_EQ(f.q.count, 3);

    EXPECT_EQ(f.q.pop(), n);
    EXPECT_EQ(f.q.head, f[0]);
    EXPECT_EQ(f[0]->prev, nullptr);
}

TEST(D_Queue_push, LooksAtNoMoreThanCountNodesLinearly) {
    // Two nodes more than `count` knows of: the walk ends before it reaches an insertion point.
    linked_queue f(100, {1, 2, 3, 4});
    f.q.count = 2;
    node n = with_cost(9);

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_THAT(costs(f.q), ElementsAre(1, 2, 3, 4));
    EXPECT_EQ(n.prev, nullptr);
    EXPECT_EQ(n.next, nullptr);
    EXPECT_EQ(f.q.count, 3);
}

TEST(D_Queue_push, ReportsABrokenListFoundLinearly) {
    linked_queue f(100, {1, 5});
    f[1]->prev = nullptr;
    node other = with_cost(0);
    node n = {0, 0, 3, 0, &other, &other};

    EXPECT_EQ(f.q.push(&n), 0);

    EXPECT_EQ(f.q.count, 2);
    EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[1]));
    EXPECT_EQ(f[1]->prev, nullptr);
    EXPECT_EQ(n.prev, &other);
    EXPECT_EQ(n.next, &other);
}

// ---- more than `step` nodes queued: the indexed search

TEST(D_Queue_push, PutsANodeBeforeItsEqualsAboveStepNodes) {
    filled_queue f(3, {5, 5, 5, 5, 5});
    EXPECT_THAT(listed(f.q), ElementsAre(f[4], f[0], f[1], f[2], f[3]));

    // index[0] is the 3, from which the walk meets the older 5.
    filled_queue middle(3, {1, 2, 3, 5, 5});
    EXPECT_THAT(listed(middle.q),
                ElementsAre(middle[0], middle[1], middle[2], middle[4], middle[3]));
    EXPECT_EQ(middle[4]->prev, middle[2]);
    EXPECT_EQ(middle[3]->prev, middle[4]);
}

TEST(D_Queue_push, AppendsThroughTheIndex) {
    filled_queue f(1, {1, 2, 3});
    node other = with_cost(0);
    node n = {0, 0, 4, 0, &other, &other};

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[1], f[2], &n));
    EXPECT_EQ(f.q.tail, &n);
    EXPECT_EQ(n.prev, f[2]);
    EXPECT_EQ(n.next, nullptr);
}

TEST(D_Queue_push, LeavesThePrevOfANewHeadAloneAboveStepNodes) {
    filled_queue f(1, {5, 6});
    node other = with_cost(0);
    node n = {0, 0, 4, 0, &other, nullptr};

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_THAT(listed(f.q), ElementsAre(&n, f[0], f[1]));
    EXPECT_EQ(n.prev, &other);
    EXPECT_EQ(f[0]->prev, &n);
}

TEST(D_Queue_push, StartsTheWalkAtTheLastCheaperEntry) {
    // A stale entry that leads to another list shows where the walk began.
    linked_queue f(1, {1, 2, 30});
    linked_queue elsewhere(1, {10, 25});
    f.q.index[0] = f[0];
    f.q.index[1] = elsewhere[0];
    node n = with_cost(20);

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_THAT(costs(f.q), ElementsAre(1, 2, 30));
    EXPECT_THAT(listed(elsewhere.q), ElementsAre(elsewhere[0], &n, elsewhere[1]));
}

TEST(D_Queue_push, StopsLookingAtTheFirstEntryThatIsNotCheaper) {
    linked_queue f(1, {1, 8, 9});
    f.q.index[0] = f[1];
    f.q.index[1] = f[0];  // cheaper, but behind the entry where the search ends
    node n = with_cost(5);

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_THAT(costs(f.q), ElementsAre(1, 5, 8, 9));
    EXPECT_EQ(f.q.index[0], f[0]);  // was f[1]
    EXPECT_EQ(f.q.index[1], nullptr);
}

TEST(D_Queue_push, MovesEveryEntryBehindTheNewNodeToItsPrev) {
    linked_queue f(1, {1, 3, 5, 7});
    for (size_t k = 0; k < 4; ++k) f.q.index[k] = f[k];
    node n = with_cost(5);  // an entry of equal cost moves too

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_EQ(f.q.index[0], f[0]);
    EXPECT_EQ(f.q.index[1], f[1]);
    EXPECT_EQ(f.q.index[2], f[1]);
    EXPECT_EQ(f.q.index[3], f[2]);
    EXPECT_EQ(f.q.index[4], f[3]);  // the new fifth: the tail
    EXPECT_THAT(costs(f.q), ElementsAre(1, 3, 5, 5, 7));
}

TEST(D_Queue_push, MovesEntriesOnBehindOneThatBecomesNull) {
    linked_queue f(2, {3, 5, 7});
    f.q.index[0] = f[0];  // the head, whose prev is null
    f.q.index[1] = f[2];
    node n = with_cost(1);

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_EQ(f.q.index[0], nullptr);
    EXPECT_EQ(f.q.index[1], f[2]);  // moved to f[1], then set anew: count 4, and f[2] is the tail
    EXPECT_EQ(f.q.tail, f[2]);

    linked_queue g(3, {3, 5, 7, 9});
    g.q.index[0] = g[0];
    g.q.index[1] = g[2];
    node m = with_cost(1);
    EXPECT_EQ(g.q.push(&m), 1);
    EXPECT_EQ(g.q.index[0], nullptr);
    EXPECT_EQ(g.q.index[1], g[1]);
}

TEST(D_Queue_push, MovesNoEntryBehindANull) {
    linked_queue f(3, {3, 5, 7, 9});
    f.q.index[0] = f[1];
    f.q.index[2] = f[3];
    node n = with_cost(1);

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_EQ(f.q.index[0], f[0]);
    EXPECT_EQ(f.q.index[1], nullptr);
    EXPECT_EQ(f.q.index[2], f[3]);
}

TEST(D_Queue_push, ReportsABrokenListFoundThroughTheIndex) {
    linked_queue f(1, {1, 5});
    f[1]->prev = nullptr;
    node other = with_cost(0);
    node n = {0, 0, 3, 0, &other, &other};

    EXPECT_EQ(f.q.push(&n), 0);

    EXPECT_EQ(f.q.count, 2);
    EXPECT_EQ(f.q.head, f[0]);
    EXPECT_EQ(f.q.tail, f[1]);
    EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[1]));
    EXPECT_EQ(n.prev, &other);
    EXPECT_EQ(n.next, &other);
}

// ---- count and index

TEST(D_Queue_push, OnlyCountsANodeWhenCountIsZeroAndThereIsAHead) {
    for (const int count : {0, -3}) {
        linked_queue f(1, {4, 6});
        index_inside_an_array around(&f.q);
        f.q.count = count;
        node other = with_cost(0);
        node n = {0, 0, 5, 0, &other, &other};

        EXPECT_EQ(f.q.push(&n), 1);

        EXPECT_EQ(f.q.count, count + 1);
        EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[1]));
        EXPECT_EQ(f.q.tail, f[1]);
        EXPECT_EQ(n.prev, &other);
        EXPECT_EQ(n.next, &other);
        // A count of 1 is a multiple of the step; one below 1 marks no position.
        EXPECT_EQ(f.q.index[0], count == 0 ? f[1] : nullptr);
        EXPECT_TRUE(around.is_untouched());
    }
}

TEST(D_Queue_push, MarksTheTailAtEveryMultipleOfStep) {
    filled_queue f(2, {1, 2, 3, 4});
    EXPECT_EQ(f.q.index[0], f[1]);
    EXPECT_EQ(f.q.index[1], f[3]);
    EXPECT_EQ(f.q.index[2], nullptr);

    f.q.pop();
    EXPECT_EQ(f.q.index[0], f[2]);
    EXPECT_EQ(f.q.index[1], nullptr);  // the tail's next
}

TEST(D_Queue_push, MarksTheTailAlsoWhenTheNewNodeIsNotTheTail) {
    filled_queue f(2, {9, 1});
    EXPECT_EQ(f.q.head, f[1]);
    EXPECT_EQ(f.q.index[0], f[0]);
}

TEST(D_Queue_push, HasNoMarkBeyondThe100th) {
    filled_queue f(1);
    index_inside_an_array around(&f.q);
    for (int i = 0; i < 105; ++i) f.push(i);
    for (size_t k = 0; k < 100; ++k) EXPECT_EQ(f.q.index[k], f[k]) << k;

    // With all 100 entries in use the search ends with the last one.
    node* const dear = f.push(102);
    EXPECT_EQ(dear->next, f[102]);
    node* const cheap = f.push(-1);
    EXPECT_EQ(f.q.head, cheap);
    EXPECT_EQ(f.q.index[99], f[98]);
    EXPECT_EQ(f.q.count, 107);
    f.q.pop();
    EXPECT_TRUE(around.is_untouched());
}

// ---- pop

TEST(D_Queue_pop, LeavesTheLinksOfTheNodeAndTheTail) {
    filled_queue f(100, {1, 2});
    node* const first = f[0];

    EXPECT_EQ(f.q.pop(), first);
    EXPECT_EQ(first->next, f[1]);
    EXPECT_EQ(f.q.tail, f[1]);
    EXPECT_EQ(f.q.count, 1);

    EXPECT_EQ(f.q.pop(), f[1]);
    EXPECT_EQ(f.q.head, nullptr);
    EXPECT_EQ(f.q.tail, f[1]);  // stale from now on
    EXPECT_EQ(f.q.count, 0);
    EXPECT_TRUE(f.q.empty());
}

TEST(D_Queue_pop, MovesIndexEntriesOnUpToTheFirstNull) {
    linked_queue f(1, {1, 2, 3, 4});
    f.q.index[0] = f[1];
    f.q.index[1] = f[3];
    f.q.index[3] = f[0];

    f.q.pop();

    EXPECT_EQ(f.q.index[0], f[2]);
    EXPECT_EQ(f.q.index[1], nullptr);
    EXPECT_EQ(f.q.index[2], nullptr);
    EXPECT_EQ(f.q.index[3], f[0]);
}

TEST(D_Queue_pop, MovesAll100IndexEntriesOnAndNoMore) {
    filled_queue f(1);
    index_inside_an_array around(&f.q);
    for (int i = 0; i < 101; ++i) f.push(i);
    f.q.index[100] = f[50];  // behind the index

    f.q.pop();

    for (size_t k = 0; k < 100; ++k) EXPECT_EQ(f.q.index[k], f[k + 1]) << k;
    EXPECT_EQ(f.q.index[100], f[50]);
}

TEST(D_Queue_pop, NeverCountsBelowZero) {
    linked_queue f(100, {1, 2, 3});
    f.q.count = 1;
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(f.q.pop(), f[static_cast<size_t>(i)]);
        EXPECT_EQ(f.q.count, 0);
    }
}

// Whoever writes the count may write any number.
TEST(D_Queue_pop, CountsTheLowestNumberAsNone) {
    linked_queue f(100, {1, 2});
    f.q.count = INT_MIN;
    f.q.pop();
    EXPECT_EQ(f.q.count, 0);
}

TEST(D_Queue_push, CountsOnFromTheHighestNumberToTheLowest) {
    linked_queue f(100, {1, 2});
    f.q.count = INT_MAX;
    node n = with_cost(3);
    EXPECT_EQ(f.q.push(&n), 1);
    EXPECT_EQ(f.q.count, INT_MIN);
}

// ---- a null entry comes back, and what it hid has been popped

namespace {

// Four nodes make four entries. Then a new head makes the first entry null: its node is the head no
// longer and has no `prev`. The entries behind it are no longer moved, and all nodes are popped.
struct hidden_entries : filled_queue {
    hidden_entries() : filled_queue(1, {1, 2, 3, 4}) {
        q.pop();
        push(0);
        while (!q.empty()) q.pop();
    }
};

}  // namespace

TEST(D_Queue_push, FindsPoppedNodesBehindANullThatIsSetAgain) {
    hidden_entries f;
    EXPECT_EQ(f.q.index[0], nullptr);
    EXPECT_EQ(f.q.index[1], f[1]);

    node* const first = f.push(10);

    EXPECT_EQ(f.q.index[0], first);
    EXPECT_EQ(f.q.index[1], f[1]) << "popped";
}

TEST(D_Queue_push, LosesANodeDearerThanThePoppedOnesItWalksFrom) {
    hidden_entries f;
    node* const first = f.push(10);
    node* const second = f.push(20);
    ASSERT_EQ(f.q.index[2], f[2]) << "popped";

    node* const third = f.push(30);

    EXPECT_EQ(third->prev, f[3]);
    EXPECT_EQ(f.q.tail, third);
    EXPECT_THAT(listed(f.q), ElementsAre(first, second));
    EXPECT_EQ(f.q.count, 3);
}

TEST(D_Queue_push, SeesNoPoppedNodeWhereAQueuedOneIsNotCheaper) {
    hidden_entries f;
    node* const first = f.push(10);
    node* const second = f.push(20);

    node* const third = f.push(15);

    EXPECT_THAT(listed(f.q), ElementsAre(first, third, second));
}

// ---- the engine lowers the cost of a node: it unlinks the node and pushes it again

TEST(D_Queue_push, LeavesAnEntryOneNodeNearerTheHeadForEachNodeLoweredBeforeIt) {
    filled_queue f(2, {1, 5, 6, 7});
    ASSERT_EQ(f.q.index[1], f[3]);
    f[2]->prev->next = f[2]->next;  // the 6
    f[2]->next->prev = f[2]->prev;
    --f.q.count;
    f[2]->cost = 3;

    EXPECT_EQ(f.q.push(f[2]), 1);

    EXPECT_THAT(listed(f.q), ElementsAre(f[0], f[2], f[1], f[3]));
    EXPECT_EQ(f.q.index[0], f[0]);  // was f[1], which is third now
}

// ---- rings

// An entry whose `prev` leads forward lets a push close the list behind itself.
TEST(D_Queue_push, DropsAListThatAnEarlierPushClosedIntoARing) {
    linked_queue f(1, {10, 20, 30, 40});
    f[2]->prev = f[3];
    node closing = with_cost(25);
    ASSERT_EQ(f.q.push(&closing), 1);
    ASSERT_EQ(f[2]->next, f[3]);
    ASSERT_EQ(f[3]->next, &closing);
    ASSERT_EQ(closing.next, f[2]);

    // A walk that ends before the ring is none the wiser.
    node early = with_cost(15);
    EXPECT_EQ(f.q.push(&early), 1);
    EXPECT_EQ(f[0]->next, &early);
    EXPECT_EQ(early.next, f[1]);
    EXPECT_EQ(f.q.count, 6);

    // So is one that ends inside it.
    node inside = with_cost(35);
    EXPECT_EQ(f.q.push(&inside), 1);
    EXPECT_EQ(f[2]->next, &inside);
    EXPECT_EQ(inside.next, f[3]);
    EXPECT_EQ(f.q.count, 7);

    node other = with_cost(0);
    node late = {0, 0, 50, 0, &other, &other};
    EXPECT_EQ(f.q.push(&late), 0);
    EXPECT_EQ(f.q.head, nullptr);
    EXPECT_EQ(f.q.tail, nullptr);
    EXPECT_EQ(f.q.count, 0);
    EXPECT_TRUE(f.q.empty());
    EXPECT_EQ(late.prev, &other);
    EXPECT_EQ(late.next, &other);

    EXPECT_EQ(f.q.push(&late), 1);
    EXPECT_THAT(listed(f.q), ElementsAre(&late));
}

TEST(D_Queue_push, DropsAListWhoseStaleEntryLeadsIntoARing) {
    linked_queue f(1, {10, 90});
    linked_queue ring(1, {20, 30, 40});
    ring[2]->next = ring[0];
    f.q.index[0] = f[0];
    f.q.index[1] = ring[1];  // popped long ago
    node n = with_cost(50);

    EXPECT_EQ(f.q.push(&n), 0);

    EXPECT_EQ(f.q.head, nullptr);
    EXPECT_EQ(f.q.tail, nullptr);
    EXPECT_EQ(f.q.count, 0);
    EXPECT_EQ(n.prev, nullptr);
    EXPECT_EQ(n.next, nullptr);
}

TEST(D_Queue_push, WalksPastARingThatTheIndexAvoids) {
    linked_queue f(1, {10, 20, 30, 60});
    f[2]->next = f[1];
    f.q.index[0] = f[3];
    node n = with_cost(70);

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_EQ(f[3]->next, &n);
    EXPECT_EQ(f.q.tail, &n);
    EXPECT_EQ(f.q.count, 5);
}

TEST(D_Queue_push, FindsRingsOfAnySizeBehindAnyLead) {
    for (size_t lead = 0; lead < 12; ++lead) {
        for (size_t ring = 1; ring < 12; ++ring) {
            linked_queue f(1, std::vector<int>(lead + ring, 7));
            f[lead + ring - 1]->next = f[lead];
            f.q.count = 100;
            node n = with_cost(8);
            ASSERT_EQ(f.q.push(&n), 0) << lead << " + " << ring;
            ASSERT_EQ(f.q.head, nullptr);
            ASSERT_EQ(f.q.tail, nullptr);
            ASSERT_EQ(f.q.count, 0);
        }
    }
}

TEST(D_Queue_push, TakesNoWalkThatEndsForARing) {
    for (size_t length = 2; length < 70; ++length) {
        linked_queue f(1, std::vector<int>(length, 7));
        node n = with_cost(8);
        ASSERT_EQ(f.q.push(&n), 1);
        ASSERT_EQ(n.prev, f[length - 1]);
        ASSERT_EQ(f.q.tail, &n);
        ASSERT_EQ(listed(f.q).size(), length + 1);
    }
}

TEST(D_Queue_push, EndsALinearWalkRoundARingByItself) {
    linked_queue f(100, {7, 7, 7});
    f[2]->next = f[0];
    node n = with_cost(8);

    EXPECT_EQ(f.q.push(&n), 1);

    EXPECT_EQ(f.q.count, 4);
    EXPECT_EQ(f.q.head, f[0]);
    EXPECT_EQ(n.prev, nullptr);
    EXPECT_EQ(n.next, nullptr);
}
