package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotSame;

import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import org.junit.jupiter.api.Test;

class WorkerTest {
    private final List<String> done = Collections.synchronizedList(new ArrayList<>());
    private final Worker worker = new Worker("tested", () -> done.add("after"),
            trouble -> done.add(trouble.getMessage()));

    @Test
    void tasksAreDoneInTheirOrderByOneOtherThread() {
        List<Thread> threads = Collections.synchronizedList(new ArrayList<>());
        for (int i = 0; i < 3; ++i) {
            String name = "task " + i;
            worker.add(() -> {
                done.add(name);
                threads.add(Thread.currentThread());
            });
        }
        worker.close(() -> done.add("last"));
        assertEquals(List.of("task 0", "after", "task 1", "after", "task 2", "after", "last",
                "after"), done);
        assertNotSame(Thread.currentThread(), threads.get(0));
        assertEquals(1, threads.stream().distinct().count());
    }

    @Test
    void taskThatFailsIsToldAndTheNextOneDone() {
        worker.add(() -> {
            throw new IllegalStateException("an exception");
        });
        worker.add(() -> {
            throw new OutOfMemoryError("no memory");
        });
        worker.add(() -> {
            throw new NoClassDefFoundError("no class");
        });
        worker.close(() -> done.add("last"));
        assertEquals(List.of("an exception", "after", "no memory", "after", "no class", "after",
                "last", "after"), done);
    }

    @Test
    void tasksAfterClosingAreNotDone() {
        worker.close(() -> worker.add(() -> done.add("late")));
        worker.add(() -> done.add("later"));
        assertEquals(List.of("after"), done);
    }
}
