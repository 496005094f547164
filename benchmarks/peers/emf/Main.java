import java.util.Arrays;
import java.util.List;

/**
 * Runs workloads on libraries of the given size and prints a line for each: whose figure it is,
 * its name, and the nanoseconds, or bytes, of one operation.
 * Usage: Main BOOKS [NAME...]
 */
public final class Main {
    private Main() {}

    public static void main(String[] arguments) {
        List<String> wanted = Arrays.asList(arguments).subList(1, arguments.length);
        Measure measure = new Measure(Integer.parseInt(arguments[0]), wanted);
        measureFilled(measure);
        Proxies.measure(measure);
        Creation.measure(measure);
        Deletion.measure(measure);
    }

    /** What does not need a library of its own. */
    private static void measureFilled(Measure measure) {
        Library library = Library.filled(measure.size);
        Access.measure(measure, library);
        Queries.measure(measure, library);
        Recording.measure(measure, library);
        Moves.measure(measure, library);
    }
}
