package com.velt.android.orvane.lumetrix.desktop.editing;

import java.util.concurrent.BlockingQueue;
import java.util.concurrent.LinkedBlockingQueue;
import java.util.function.Consumer;

/**
 * A thread that does tasks in their order. A task that fails, however badly, is reported, and the
 * next one done.
 */
final class Worker {
    private final BlockingQueue<Runnable> tasks = new LinkedBlockingQueue<>();
    private final Runnable afterEach;
    private final Consumer<Throwable> failed;
    private final Thread thread;
    private boolean closing;  // read and written by the thread alone

    /**
     * Starts the thread.
     *
     * @param afterEach is done after each task, also one that has failed
     * @param failed is told what went wrong
     */
    Worker(String name, Runnable afterEach, Consumer<Throwable> failed) {
        this.afterEach = afterEach;
        this.failed = failed;
        thread = new Thread(this::work, name);
        thread.start();
    }

    private void work() {
        while (!closing) {
            try {
                Runnable task = tasks.take();
                attempt(task);
                attempt(afterEach);
            } catch (InterruptedException e) {
                throw new IllegalStateException("nobody interrupts this thread", e);
            }
        }
    }

    /** Errors as well: memory may do for the next task, and without the thread all would stop. */
    private void attempt(Runnable task) {
        try {
            task.run();
        } catch (RuntimeException | Error e) {
            failed.accept(e);
        }
    }

    /** Has a task done after those that wait already. After closing it is never done. */
    void add(Runnable task) {
        tasks.add(task);
    }

    /** Tells whether no task waits. */
    boolean isIdle() {
        return tasks.isEmpty();
    }

    /** Ends the thread once it has done what waits and, after it, a last task; waits for that. */
    void close(Runnable last) {
        tasks.add(() -> {
            closing = true;
            last.run();
        });
        try {
            thread.join();
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }
}
