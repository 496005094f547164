import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.change.ChangeDescription;

import java.util.ArrayList;
import java.util.List;
import java.util.function.Consumer;

/**
 * Moving books from one library to the other, recorded, and undoing that. The ways are the fastest
 * ones of several; those whose cost a move grows with the size move only as many as end in time.
 */
final class Moves {
    /**
     * Of ways that can't be had in time for more: the end of a recording that saw the front of a list
     * change takes the square of its length, and detaching a million objects a minute.
     */
    private static final int MOST_BOOKS = 200_000;

    private final Measure measure;
    private final Library library;
    private final List<EObject> from;
    private final List<EObject> to;

    private Moves(Measure measure, Library library) {
        this.measure = measure;
        this.library = library;
        from = Library.list(library.library, Library.BOOKS);
        to = Library.list(library.secondLibrary, Library.BOOKS);
    }

    static void measure(Measure measure, Library library) {
        Moves moves = new Moves(measure, library);
        moves.measure("from the back", 1_000_000_000, count -> {
            for (int i = 0; i < count; ++i)
                moves.to.add(moves.from.remove(moves.from.size() - 1));
        });
        if (measure.size > MOST_BOOKS)
            return;
        moves.measure("from the front", 500_000_000, count -> {
            for (int i = 0; i < count; ++i)
                moves.to.add(moves.from.get(0));
        });
        moves.measure("all at once", Long.MAX_VALUE, count -> {
            List<EObject> all = new ArrayList<>(moves.from);
            moves.from.clear();
            moves.to.addAll(all);
        });
    }

    /** @param steps how often a book is passed at most, if each move passes all of them. */
    private void measure(String way, long steps, Consumer<Integer> move) {
        int count = (int) Math.min(measure.size, steps / measure.size);
        measure.measure(List.of("move " + way, "undo moves " + way), () -> {
            ChangeDescription[] recorded = new ChangeDescription[1];
            System.gc();  // of the round before
            double moved = Clock.time(
                () -> recorded[0] = Recording.record(library, () -> move.accept(count)));
            Measure.require(to.size() == count, "books have moved");
            double undone = Clock.time(recorded[0]::apply);
            Measure.require(to.isEmpty() && from.size() == measure.size, "books are back");
            return new double[] {moved / count, undone / count};
        });
    }
}
