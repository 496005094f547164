import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.util.EcoreUtil;

import java.util.ArrayList;
import java.util.List;

/**
 * Taking every second book out of its library, one by one from the front; references to it stay.
 * Each removal passes the books before and behind it, and its cost changes evenly from the first one
 * to the last. So those in the middle, which cost the mean, stand for all.
 */
final class Deletion {
    private static final int MOST = 4000;

    private final EObject[] books;
    private final List<EObject> contents;
    /** The removals are of every second book from `first` on, which stands at `position`. */
    private final int count;
    private final int first;
    private final int position;

    private Deletion(Library library) {
        books = library.books;
        contents = Library.list(library.library, Library.BOOKS);
        count = Math.min(books.length / 2, MOST);
        first = (books.length / 2 - count) / 2 * 2;
        position = first / 2;
        removeThoseBefore();
    }

    static void measure(Measure measure) {
        String workload = "delete every second book";
        if (!measure.wants(workload))
            return;
        Deletion deletion = new Deletion(Library.filled(measure.size));
        measure.measure(workload, deletion::round);
    }

    private double round() {
        int before = contents.size();
        double taken = Clock.time(() -> {
            for (int i = 0; i < count; ++i)
                EcoreUtil.remove(books[first + 2 * i + 1]);
        });
        Measure.require(contents.size() == before - count, "books are gone");
        for (int i = 0; i < count; ++i)
            contents.add(position + 2 * i + 1, books[first + 2 * i + 1]);
        return taken / count;
    }

    private void removeThoseBefore() {
        List<EObject> others = new ArrayList<>();
        for (int i = 0; i < books.length; ++i) {
            if (i >= first || i % 2 == 0)
                others.add(books[i]);
        }
        contents.clear();
        contents.addAll(others);
        Measure.require(contents.get(position) == books[first], "the first book to stay");
        System.gc();
    }
}
