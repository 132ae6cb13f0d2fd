package com.velt.android.orvane.lumetrix.desktop.editing;

import java.io.IOException;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.TimeUnit;
import java.util.function.Consumer;

/** A thread that reads and writes files, one job after the other. */
final class FileThread implements AutoCloseable {
    private final ExecutorService executor =
            Executors.newSingleThreadExecutor(task -> new Thread(task, "files"));
    private final Consumer<String> busy;
    private final Consumer<String> failed;

    /** Something done with files. */
    interface Job {
        void run() throws IOException;
    }

    /**
     * Starts the thread.
     *
     * @param busy is told what is going on, and with an empty text that it is over
     * @param failed is told of a job that failed, and why
     */
    FileThread(Consumer<String> busy, Consumer<String> failed) {
        this.busy = busy;
        this.failed = failed;
    }

    /** Has a job done whose failures nobody can mend by choosing another file. */
    CompletableFuture<Boolean> run(String what, String failure, Job job) {
        return run(what, failure, "", job);
    }

    /**
     * Has a job done.
     *
     * @param what what is going on, such as {@code Opening fig.jpg}
     * @param failure what is to be said when it fails, up to the colon
     * @param cure a sentence about how to mend what is wrong with the file, or empty
     * @return whether it was done; after closing it never is
     */
    CompletableFuture<Boolean> run(String what, String failure, String cure, Job job) {
        try {
            return CompletableFuture.supplyAsync(() -> isDone(what, failure, cure, job), executor);
        } catch (RejectedExecutionException e) {
            return CompletableFuture.completedFuture(false);
        }
    }

    private boolean isDone(String what, String failure, String cure, Job job) {
        busy.accept(what);
        try {
            job.run();
            return true;
        } catch (IOException | RuntimeException | OutOfMemoryError e) {
            boolean curable = e instanceof IOException && !cure.isEmpty();
            failed.accept(failure + ": " + Troubles.describe(e) + (curable ? ". " + cure : "."));
            return false;
        } finally {
            busy.accept("");
        }
    }

    /** Ends the thread once its jobs are done, and waits for that. */
    @Override
    public void close() {
        executor.shutdown();
        try {
            executor.awaitTermination(1, TimeUnit.MINUTES);
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }
}
