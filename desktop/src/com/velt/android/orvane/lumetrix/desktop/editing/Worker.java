package com.velt.android.orvane.lumetrix.desktop.editing;

import java.util.concurrent.BlockingQueue;
import java.util.concurrent.LinkedBlockingQueue;
import java.util.function.Consumer;

/** A thread that does tasks in their order. A task that fails is reported, and the next one done. */
final class Worker implements AutoCloseable {
    private final BlockingQueue<Runnable> tasks = new LinkedBlockingQueue<>();
    private final Consumer<Throwable> failed;
    private final Thread thread;
    private boolean closing;  // read and written by the thread alone

    Worker(String name, Consumer<Throwable> failed) {
        this.failed = failed;
        thread = new Thread(this::work, name);
        thread.start();
    }

    private void work() {
        while (!closing) {
            try {
                tasks.take().run();
            } catch (InterruptedException e) {
                throw new IllegalStateException("nobody interrupts this thread", e);
            } catch (RuntimeException | OutOfMemoryError | UnsatisfiedLinkError e) {
                failed.accept(e);
            }
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

    /** Ends the thread once it has done what waits, and waits for that. */
    @Override
    public void close() {
        tasks.add(() -> closing = true);
        try {
            thread.join();
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }
}
