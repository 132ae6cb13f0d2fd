import java.io.BufferedReader;
import java.io.IOException;
import java.io.InputStreamReader;
import java.io.Writer;
import java.util.Arrays;
import java.util.List;
import javax.tools.JavaCompiler;
import javax.tools.StandardJavaFileManager;
import javax.tools.ToolProvider;

/**
 * A Java compiler that stays: each line of its input holds the arguments of one run with tabs
 * between them, "--" before the source files. Answers "ok" or "failed".
 */
public final class Compiler {
    public static void main(String[] arguments) throws IOException {
        JavaCompiler compiler = ToolProvider.getSystemJavaCompiler();
        StandardJavaFileManager files = compiler.getStandardFileManager(null, null, null);
        BufferedReader input = new BufferedReader(new InputStreamReader(System.in));
        for (String line = input.readLine(); line != null; line = input.readLine()) {
            List<String> words = Arrays.asList(line.split("\t"));
            int end = words.indexOf("--");
            boolean ok = compiler.getTask(Writer.nullWriter(), files, problem -> {},
                    words.subList(0, end), null,
                    files.getJavaFileObjectsFromStrings(words.subList(end + 1, words.size())))
                    .call();
            System.out.println(ok ? "ok" : "failed");
        }
    }
}
