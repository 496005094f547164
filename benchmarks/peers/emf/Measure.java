import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import java.util.Locale;
import java.util.Random;
import java.util.function.DoubleSupplier;
import java.util.function.Supplier;

/** How workloads are measured: which are wanted, how often they run, and what is printed. */
final class Measure {
    private static final int WARM_UP_ROUNDS = 5;
    private static final int ROUNDS = 3;
    private static final int MOST_ROUNDS = 101;
    private static final double WARM_UP_NANOSECONDS = 300e6;
    private static final double NANOSECONDS = 100e6;

    final int size;
    /** The numbers of all books, shuffled. */
    final int[] order;
    private final List<String> wanted;

    /** @param wanted names of workloads, where "*" at the end stands for anything; none for all. */
    Measure(int size, List<String> wanted) {
        this.size = size;
        this.wanted = wanted;
        List<Integer> numbers = new ArrayList<>();
        for (int i = 0; i < size; ++i)
            numbers.add(i);
        Collections.shuffle(numbers, new Random(1));
        order = numbers.stream().mapToInt(Integer::intValue).toArray();
    }

    /** Ends the program if a workload did not do what it should. */
    static void require(boolean holds, String what) {
        if (!holds)
            throw new IllegalStateException("expected: " + what);
    }

    boolean wants(String workload) {
        return wanted.isEmpty() || wanted.stream().anyMatch(name -> matches(workload, name));
    }

    private static boolean matches(String workload, String name) {
        int length = name.length() - 1;
        return name.endsWith("*") ? workload.startsWith(name.substring(0, length))
                                  : workload.equals(name);
    }

    /** Prints the median of what `round` gives, the time of one operation. */
    void measure(String workload, DoubleSupplier round) {
        measure(List.of(workload), () -> new double[] {round.getAsDouble()});
    }

    /** The same for workloads that are measured in one round, a figure each. */
    void measure(List<String> workloads, Supplier<double[]> round) {
        if (workloads.stream().noneMatch(this::wants))
            return;
        run(round, WARM_UP_ROUNDS, WARM_UP_NANOSECONDS);
        List<double[]> figures = run(round, ROUNDS, NANOSECONDS);
        for (int i = 0; i < workloads.size(); ++i) {
            int index = i;
            double[] sorted = figures.stream().mapToDouble(of -> of[index]).sorted().toArray();
            print(workloads.get(i), sorted[sorted.length / 2]);
        }
    }

    void print(String workload, double figure) {
        System.out.printf(Locale.ROOT, "theirs\t%s\t%.3f%n", workload, figure);
    }

    /** Runs so many rounds, or more if they are short. */
    private static List<double[]> run(Supplier<double[]> round, int rounds, double nanoseconds) {
        List<double[]> figures = new ArrayList<>();
        double[] spent = {0};
        while (figures.size() < rounds || (spent[0] < nanoseconds && figures.size() < MOST_ROUNDS))
            spent[0] += Clock.time(() -> figures.add(round.get()));
        return figures;
    }

    /** The bytes of all live objects: collects until two readings agree. */
    static long usedBytes() {
        long last = -1;
        for (int i = 0; i < 6; ++i) {
            System.gc();
            try {
                Thread.sleep(20);  // lets the collector's helpers drop what was only weakly held
            } catch (InterruptedException e) {
                throw new IllegalStateException(e);
            }
            long used = Runtime.getRuntime().totalMemory() - Runtime.getRuntime().freeMemory();
            if (used == last)
                break;
            last = used;
        }
        return last;
    }
}
