import java.io.IOException;
import java.io.UncheckedIOException;
import java.lang.management.ManagementFactory;
import java.lang.management.ThreadMXBean;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.stream.Stream;

/**
 * Processor time of this thread and of the serial collector, which runs while this thread waits.
 * On an idle machine this is the time that passes; the compiler's threads do not count.
 */
final class Clock {
    private static final ThreadMXBean THREADS = ManagementFactory.getThreadMXBean();
    private static final Path COLLECTOR = findCollector();

    private Clock() {}

    /** The nanoseconds of one run of `body`. */
    static double time(Runnable body) {
        long collecting = collectorTime();
        long begin = THREADS.getCurrentThreadCpuTime();
        body.run();
        long running = THREADS.getCurrentThreadCpuTime() - begin;
        return running + collectorTime() - collecting;
    }

    private static long collectorTime() {
        return Long.parseLong(read(COLLECTOR.resolve("schedstat")).split(" ")[0]);
    }

    /** The directory of the thread that does all the work of the serial collector. */
    private static Path findCollector() {
        try (Stream<Path> threads = Files.list(Path.of("/proc/self/task"))) {
            return threads.filter(t -> read(t.resolve("comm")).strip().equals("VM Thread"))
                .findFirst().orElseThrow();
        } catch (IOException e) {
            throw new UncheckedIOException(e);
        }
    }

    private static String read(Path file) {
        try {
            return Files.readString(file);
        } catch (IOException e) {
            throw new UncheckedIOException(e);
        }
    }
}
