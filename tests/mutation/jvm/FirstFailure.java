import java.lang.management.ManagementFactory;
import java.lang.management.ThreadMXBean;
import org.junit.platform.engine.TestExecutionResult;
import org.junit.platform.engine.discovery.DiscoverySelectors;
import org.junit.platform.launcher.LauncherDiscoveryRequest;
import org.junit.platform.launcher.TestExecutionListener;
import org.junit.platform.launcher.TestIdentifier;
import org.junit.platform.launcher.core.LauncherDiscoveryRequestBuilder;
import org.junit.platform.launcher.core.LauncherFactory;

/**
 * Runs JUnit tests and ends the process at the first that fails: with 0 when all passed, 1 when one
 * failed, 2 when there were none.
 *
 * <p>Arguments are names of classes, or ids of tests as this prints them, which begin with "[". Says
 * of each test that it runs and, at its end, how many seconds of the processor its thread took.
 */
public final class FirstFailure implements TestExecutionListener {
    private final ThreadMXBean threads = ManagementFactory.getThreadMXBean();
    private int passed;
    private long began;

    public static void main(String[] arguments) {
        LauncherDiscoveryRequestBuilder request = LauncherDiscoveryRequestBuilder.request();
        for (String argument : arguments) {
            request.selectors(argument.startsWith("[")
                    ? DiscoverySelectors.selectUniqueId(argument)
                    : DiscoverySelectors.selectClass(argument));
        }
        FirstFailure listener = new FirstFailure();
        LauncherDiscoveryRequest tests = request.build();
        LauncherFactory.create().execute(tests, listener);
        end(listener.passed > 0 ? 0 : 2);
    }

    /** Without waiting for threads that a test may have left. */
    private static void end(int status) {
        System.out.flush();
        Runtime.getRuntime().halt(status);
    }

    @Override
    public void executionStarted(TestIdentifier test) {
        if (!test.isTest()) return;
        System.out.println("RUN " + test.getUniqueId());
        System.out.flush();
        began = threads.getCurrentThreadCpuTime();
    }

    @Override
    public void executionFinished(TestIdentifier test, TestExecutionResult result) {
        if (result.getStatus() == TestExecutionResult.Status.FAILED) {
            System.out.println("FAILED " + test.getUniqueId());
            end(1);
        }
        if (!test.isTest()) return;
        ++passed;
        double seconds = (threads.getCurrentThreadCpuTime() - began) / 1e9;
        System.out.println("OK " + seconds + " " + test.getUniqueId());
    }
}
