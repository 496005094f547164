import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.change.ChangeDescription;
import org.eclipse.emf.ecore.change.util.ChangeRecorder;

import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import java.util.Locale;
import java.util.Random;

/**
 * Runs each workload on a library of the given size and prints a line for each: its name and the
 * nanoseconds, or bytes, a book. Usage: Workloads BOOKS [ROUNDS]
 */
public final class Workloads {
    private static final int WARM_UP = 5;

    private final int size;
    private final int rounds;
    private int[] shuffled;
    private long sink;

    private Workloads(int size, int rounds) {
        this.size = size;
        this.rounds = rounds;
        List<Integer> order = new ArrayList<>();
        for (int i = 0; i < size; ++i)
            order.add(i);
        Collections.shuffle(order, new Random(1));
        shuffled = order.stream().mapToInt(Integer::intValue).toArray();
    }

    public static void main(String[] arguments) {
        Locale.setDefault(Locale.ROOT);
        int size = Integer.parseInt(arguments[0]);
        int rounds = arguments.length > 1 ? Integer.parseInt(arguments[1]) : 5;
        new Workloads(size, rounds).run();
    }

    private interface Round {
        /** The nanoseconds that the measured part took. */
        long run();
    }

    /** The time of one run of `body`. */
    private static long time(Runnable body) {
        long begin = System.nanoTime();
        body.run();
        return System.nanoTime() - begin;
    }

    /** Prints the median of the rounds that follow the warm-up, for each of `operations`. */
    private void measure(String workload, long operations, Round round) {
        for (int i = 0; i < WARM_UP; ++i)
            round.run();
        List<Long> times = new ArrayList<>();
        for (int i = 0; i < rounds; ++i)
            times.add(round.run());
        Collections.sort(times);
        System.out.printf("%s\t%.2f%n", workload, (double) times.get(rounds / 2) / operations);
    }

    private void run() {
        new Library(1).fill();  // loads the classes
        Library library = new Library(size);
        long before = usedBytes();
        library.fill();
        System.out.printf("bytes a book\t%.1f%n", (double) (usedBytes() - before) / size);
        measure("create", size, () -> {
            Library made = new Library(size);
            return time(made::fill);
        });
        library.readIds();
        EObject[] books = library.books;

        measure("read in order", size, () -> time(() -> {
            for (EObject book : books)
                sink += (Integer) book.eGet(Library.PAGES);
        }));
        measure("read at random", size, () -> time(() -> {
            for (int i : shuffled)
                sink += (Integer) books[i].eGet(Library.PAGES);
        }));
        measure("set unrecorded", size, () -> time(() -> setPages(books)));
        measure("find by UUID", size, () -> time(() -> {
            for (int i : shuffled)
                sink += library.resource.getEObject(library.ids[i]) == null ? 1 : 0;
        }));
        measureRecorded(library);
        measureMoves(library);
        measure("delete half", size / 2, () -> {
            Library made = new Library(size);
            made.fill();
            List<EObject> contents = Library.list(made.library, Library.BOOKS);
            return time(() -> {
                for (int i = made.books.length - 1; i >= 0; i -= 2)
                    contents.remove(made.books[i]);
            });
        });
        if (sink == 42)
            System.out.println();  // the sums are needed, says this line
    }

    private void setPages(EObject[] books) {
        for (EObject book : books)
            book.eSet(Library.PAGES, (Integer) book.eGet(Library.PAGES) % 1000 + 1);
    }

    private void measureRecorded(Library library) {
        ChangeDescription[] recorded = new ChangeDescription[1];
        Round set = () -> time(() -> {
            ChangeRecorder recorder = new ChangeRecorder(library.resource);
            setPages(library.books);
            recorded[0] = recorder.endRecording();
            recorder.dispose();
        });
        measure("set recorded", size, set);
        measure("undo", size, () -> {
            set.run();
            return time(recorded[0]::apply);
        });
        int[] next = {0};
        measure("one recorded set", 1, () -> time(() -> {
            ChangeRecorder recorder = new ChangeRecorder(library.resource);
            EObject book = library.books[next[0]++ % size];
            book.eSet(Library.PAGES, (Integer) book.eGet(Library.PAGES) % 1000 + 1);
            recorder.endRecording();
            recorder.dispose();
        }));
    }

    /** A thousand recorded moves to the other library, from the front or the back. */
    private void measureMoves(Library library) {
        int moves = Math.min(size, 1000);
        List<EObject> contents = Library.list(library.library, Library.BOOKS);
        measureMoves("move from the front", library, moves, () -> contents.get(0));
        measureMoves("move from the back", library, moves, () -> contents.get(contents.size() - 1));
    }

    private void measureMoves(String workload, Library library, int moves,
                              java.util.function.Supplier<EObject> pick) {
        measure(workload, moves, () -> {
            ChangeDescription[] recorded = new ChangeDescription[1];
            long taken = time(() -> {
                ChangeRecorder recorder = new ChangeRecorder(library.resource);
                List<EObject> target = Library.list(library.secondLibrary, Library.BOOKS);
                for (int i = 0; i < moves; ++i)
                    target.add(pick.get());
                recorded[0] = recorder.endRecording();
                recorder.dispose();
            });
            recorded[0].apply();
            return taken;
        });
    }

    /** The bytes of all live objects: collects until two readings agree. */
    private static long usedBytes() {
        long last = -1;
        for (int i = 0; i < 50; ++i) {
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
