import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.change.ChangeDescription;
import org.eclipse.emf.ecore.change.util.ChangeRecorder;

import java.util.List;

/** Setting pages with old values kept, and undoing that. */
final class Recording {
    private Recording() {}

    static void measure(Measure measure, Library library) {
        EObject[] books = library.books;
        int size = measure.size;
        int[] turn = new int[1];
        if (measure.wants("bytes a recorded change"))
            measure.print("bytes a recorded change", bytesAChange(library));
        measure.measure(List.of("set recorded", "undo sets"), () -> {
            ++turn[0];
            Object before = books[size - 1].eGet(Library.PAGES);
            ChangeDescription[] recorded = new ChangeDescription[1];
            double set = Clock.time(
                () -> recorded[0] = record(library, () -> Access.setPages(books, turn[0])));
            double undone = Clock.time(recorded[0]::apply);
            Measure.require(before.equals(books[size - 1].eGet(Library.PAGES)), "pages are back");
            return new double[] {set / size, undone / size};
        });
        measure.measure("one recorded set", () -> {
            ++turn[0];
            int i = turn[0] % size;
            return Clock.time(() -> record(
                library, () -> books[i].eSet(Library.PAGES, Library.pages(i, turn[0]))));
        });
    }

    /** Keeps what `change` changes anywhere in the library, from begin to end. */
    static ChangeDescription record(Library library, Runnable change) {
        ChangeRecorder recorder = new ChangeRecorder(library.resource);
        change.run();
        ChangeDescription recorded = recorder.endRecording();
        recorder.dispose();
        return recorded;
    }

    private static double bytesAChange(Library library) {
        record(library, () -> {});  // what is made once
        long before = Measure.usedBytes();
        ChangeDescription recorded = record(library, () -> Access.setPages(library.books, 1));
        double bytes = Measure.usedBytes() - before;
        recorded.apply();
        return bytes / library.books.length;
    }
}
