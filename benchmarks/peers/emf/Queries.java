import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.util.EcoreUtil;

import java.util.ArrayList;
import java.util.Iterator;
import java.util.List;
import java.util.function.IntSupplier;

/** Questions to all books, as walks over all contents that a person would write. */
final class Queries {
    private static final String AUTHOR = "Author 7";

    private record Pair(EObject book, EObject author) {}

    private Queries() {}

    static void measure(Measure measure, Library library) {
        for (int percent : new int[] {1, 50}) {
            int least = 1000 - 10 * percent;
            int rows = measure.size / 100 * percent;
            measure(measure, "count " + percent + " %", rows, () -> countOver(library, least));
            measure(measure, "rows " + percent + " %", rows, () -> rowsOver(library, least));
        }
        measure(measure, "rows of a join", Library.BOOKS_PER_AUTHOR, () -> pairs(library));
    }

    private static void measure(Measure measure, String workload, int rows, IntSupplier walk) {
        measure.measure(workload, () -> {
            int[] found = new int[1];
            double taken = Clock.time(() -> found[0] = walk.getAsInt());
            Measure.require(found[0] == rows, "the right number of rows");
            return taken / measure.size;
        });
    }

    private static Iterator<EObject> walk(Library library) {
        return EcoreUtil.getAllContents(library.resource, /*resolve=*/false);
    }

    private static boolean isOver(EObject object, int least) {
        return object.eClass() == Library.BOOK && (Integer) object.eGet(Library.PAGES) > least;
    }

    private static int countOver(Library library, int least) {
        int count = 0;
        for (Iterator<EObject> all = walk(library); all.hasNext();)
            count += isOver(all.next(), least) ? 1 : 0;
        return count;
    }

    private static int rowsOver(Library library, int least) {
        List<EObject> rows = new ArrayList<>();
        for (Iterator<EObject> all = walk(library); all.hasNext();) {
            EObject object = all.next();
            if (isOver(object, least))
                rows.add(object);
        }
        return rows.size();
    }

    private static int pairs(Library library) {
        List<Pair> rows = new ArrayList<>();
        for (Iterator<EObject> all = walk(library); all.hasNext();) {
            EObject object = all.next();
            if (object.eClass() != Library.BOOK)
                continue;
            EObject author = (EObject) object.eGet(Library.AUTHOR_OF);
            if (author != null && AUTHOR.equals(author.eGet(Library.AUTHOR_NAME)))
                rows.add(new Pair(object, author));
        }
        return rows.size();
    }
}
