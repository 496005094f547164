/** Making a library, and what it weighs. */
final class Creation {
    private Creation() {}

    static void measure(Measure measure) {
        Library.filled(1);  // loads the classes
        if (measure.wants("bytes a book"))
            measure.print("bytes a book", bytesABook(measure.size));
        measure.measure("create", () -> {
            Library library = new Library(measure.size);
            library.makeTitles();
            System.gc();  // of the round before
            return Clock.time(library::fill) / measure.size;
        });
    }

    private static double bytesABook(int size) {
        Library library = new Library(size);
        long before = Measure.usedBytes();
        library.makeTitles();
        library.fill();
        library.dropTitles();
        double bytes = (double) (Measure.usedBytes() - before) / size;
        Measure.require(library.books[size - 1] != null, "all books are there");
        return bytes;
    }
}
