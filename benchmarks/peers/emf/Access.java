import org.eclipse.emf.ecore.EObject;

/** Reading, setting and finding books, with nothing recorded. */
final class Access {
    private Access() {}

    static void measure(Measure measure, Library library) {
        EObject[] books = library.books;
        int[] order = measure.order;
        int size = measure.size;
        long[] sum = new long[1];
        measure.measure("read in order", () -> Clock.time(() -> {
            for (EObject book : books)
                sum[0] += (Integer) book.eGet(Library.PAGES);
        }) / size);
        measure.measure("read at random", () -> Clock.time(() -> {
            for (int i : order)
                sum[0] += (Integer) books[i].eGet(Library.PAGES);
        }) / size);
        int[] turn = new int[1];
        measure.measure("set", () -> {
            ++turn[0];
            return Clock.time(() -> setPages(books, turn[0])) / size;
        });
        library.readIds();
        measure.measure("find by UUID", () -> Clock.time(() -> {
            for (int i : order)
                sum[0] += library.resource.getEObject(library.ids[i]) == books[i] ? 1 : 0;
        }) / size);
        Measure.require(!measure.wants("find by UUID") || sum[0] >= size, "all books are found");
    }

    /** Gives each book other pages than the turn before. */
    static void setPages(EObject[] books, int turn) {
        for (int i = 0; i < books.length; ++i)
            books[i].eSet(Library.PAGES, Library.pages(i, turn));
    }
}
