import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.util.EcoreUtil;

import java.util.ArrayList;
import java.util.HashSet;
import java.util.List;

/**
 * Taking every second book out of its library, one by one; references to it stay. Each removal
 * passes the other books, so in large libraries only the last few of each block are measured, and
 * those before them go at once.
 */
final class Deletion {
    private static final int BLOCKS = 16;
    /** How often a book is passed at most in what is measured. */
    private static final long STEPS = 4_000_000_000L;

    private Deletion() {}

    static void measure(Measure measure) {
        int inBlock = (int) Math.min(measure.size, STEPS / measure.size) / BLOCKS;
        measure.measure("delete every second book", () -> {
            Library library = Library.filled(measure.size);
            System.gc();  // of the round before
            double taken = 0;
            int measured = 0;
            for (int block = 0; block < BLOCKS; ++block) {
                List<EObject> gone = everySecond(library, block);
                int first = Math.max(0, gone.size() - inBlock);
                Library.list(library.library, Library.BOOKS)
                    .removeAll(new HashSet<>(gone.subList(0, first)));
                taken += Clock.time(() -> gone.listIterator(first).forEachRemaining(
                    EcoreUtil::remove));
                measured += gone.size() - first;
            }
            Measure.require(Library.list(library.library, Library.BOOKS).size()
                == measure.size - measure.size / 2, "half of the books are gone");
            return taken / measured;
        });
    }

    private static List<EObject> everySecond(Library library, int block) {
        long size = library.books.length;
        List<EObject> books = new ArrayList<>();
        for (int i = (int) (size * block / BLOCKS); i < size * (block + 1) / BLOCKS; ++i) {
            if (i % 2 == 1)
                books.add(library.books[i]);
        }
        return books;
    }
}
