import org.eclipse.emf.common.util.URI;
import org.eclipse.emf.ecore.EAttribute;
import org.eclipse.emf.ecore.EClass;
import org.eclipse.emf.ecore.EClassifier;
import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.EPackage;
import org.eclipse.emf.ecore.EReference;
import org.eclipse.emf.ecore.EcoreFactory;
import org.eclipse.emf.ecore.EcorePackage;
import org.eclipse.emf.ecore.util.EcoreUtil;
import org.eclipse.emf.ecore.xmi.impl.XMIResourceImpl;

import java.util.List;

/** Books and their authors, of classes that are made at run time, in a resource with UUIDs. */
final class Library {
    static final int BOOKS_PER_AUTHOR = 100;

    /** The classes, made once. */
    static final EClass LIBRARY = newClass("Library");
    static final EClass BOOK = newClass("Book");
    static final EClass AUTHOR = newClass("Author");
    static final EAttribute NAME = attribute(LIBRARY, "name", EcorePackage.Literals.ESTRING);
    static final EAttribute TITLE = attribute(BOOK, "title", EcorePackage.Literals.ESTRING);
    static final EAttribute PAGES = attribute(BOOK, "pages", EcorePackage.Literals.EINT);
    static final EAttribute PRICE = attribute(BOOK, "price", EcorePackage.Literals.EDOUBLE);
    static final EAttribute AUTHOR_NAME = attribute(AUTHOR, "name", EcorePackage.Literals.ESTRING);
    static final EReference BOOKS = reference(LIBRARY, "books", BOOK, -1, true);
    static final EReference AUTHORS = reference(LIBRARY, "authors", AUTHOR, -1, true);
    static final EReference LIBRARY_OF = reference(BOOK, "library", LIBRARY, 1, false);
    static final EReference AUTHOR_OF = reference(BOOK, "author", AUTHOR, 1, false);
    static final EReference BOOKS_BY = reference(AUTHOR, "books", BOOK, -1, false);
    static final EReference NEXT = reference(BOOK, "next", BOOK, 1, false);
    static final EReference PREVIOUS = reference(BOOK, "previous", BOOK, 1, false);
    /** What refers to a book of another resource. */
    static final EClass CARD = newClass("Card");
    static final EReference CARD_BOOK = reference(CARD, "book", BOOK, 1, false);

    static {
        opposites(BOOKS, LIBRARY_OF);
        opposites(AUTHOR_OF, BOOKS_BY);
        opposites(NEXT, PREVIOUS);
        EPackage pack = EcoreFactory.eINSTANCE.createEPackage();
        pack.setName("library");
        pack.setNsPrefix("library");
        pack.setNsURI("http://tarnkiln.invalid/benchmarks/library");
        pack.getEClassifiers().addAll(List.of(LIBRARY, BOOK, AUTHOR, CARD));
    }

    final Resource resource = new Resource(URI.createURI("books:library"));
    final EObject library = EcoreUtil.create(LIBRARY);
    final EObject secondLibrary = EcoreUtil.create(LIBRARY);
    final EObject[] books;
    final String[] ids;
    private String[] titles;

    /** Two libraries without books. */
    Library(int size) {
        resource.getContents().add(library);
        resource.getContents().add(secondLibrary);
        books = new EObject[size];
        ids = new String[size];
    }

    /** A library with all its books, where the collector leaves them in peace. */
    static Library filled(int size) {
        Library made = new Library(size);
        made.makeTitles();
        made.fill();
        System.gc();
        return made;
    }

    void makeTitles() {
        titles = new String[books.length];
        for (int i = 0; i < titles.length; ++i)
            titles[i] = title(i);
    }

    /** Leaves the titles to the books. */
    void dropTitles() {
        titles = null;
    }

    /** Fills the first library, the workload "create". */
    void fill() {
        List<EObject> contents = list(library, BOOKS);
        EObject author = null;
        for (int i = 0; i < books.length; ++i) {
            if (i % BOOKS_PER_AUTHOR == 0)
                author = addAuthor(i / BOOKS_PER_AUTHOR);
            EObject book = EcoreUtil.create(BOOK);
            book.eSet(TITLE, titles[i]);
            book.eSet(PAGES, pages(i, 0));
            book.eSet(PRICE, 0.5 * i);
            contents.add(book);
            book.eSet(AUTHOR_OF, author);
            if (i > 0)
                book.eSet(PREVIOUS, books[i - 1]);
            books[i] = book;
        }
    }

    /** Reads the UUIDs, by which books are found. */
    void readIds() {
        for (int i = 0; i < books.length; ++i)
            ids[i] = resource.getURIFragment(books[i]);
    }

    private EObject addAuthor(int number) {
        EObject author = EcoreUtil.create(AUTHOR);
        author.eSet(AUTHOR_NAME, "Author " + number);
        list(library, AUTHORS).add(author);
        return author;
    }

    static String title(int i) {
        return "Book" + Integer.toString(1000000 + i % 1000000).substring(1);
    }

    /** From 1 to 1000, evenly; other ones in the next turn. */
    static int pages(int i, int turn) {
        return (int) ((i * 7919L + turn) % 1000) + 1;
    }

    @SuppressWarnings("unchecked")
    static List<EObject> list(EObject owner, EReference feature) {
        return (List<EObject>) owner.eGet(feature);
    }

    /** A resource that gives each object a UUID and finds it by that. */
    static final class Resource extends XMIResourceImpl {
        Resource(URI uri) {
            super(uri);
        }

        @Override
        protected boolean useUUIDs() {
            return true;
        }
    }

    private static EClass newClass(String name) {
        EClass made = EcoreFactory.eINSTANCE.createEClass();
        made.setName(name);
        return made;
    }

    private static EAttribute attribute(EClass owner, String name, EClassifier type) {
        EAttribute made = EcoreFactory.eINSTANCE.createEAttribute();
        made.setName(name);
        made.setEType(type);
        owner.getEStructuralFeatures().add(made);
        return made;
    }

    private static EReference reference(EClass owner, String name, EClass type, int upper,
                                        boolean containment) {
        EReference made = EcoreFactory.eINSTANCE.createEReference();
        made.setName(name);
        made.setEType(type);
        made.setUpperBound(upper);
        made.setContainment(containment);
        owner.getEStructuralFeatures().add(made);
        return made;
    }

    private static void opposites(EReference one, EReference other) {
        one.setEOpposite(other);
        other.setEOpposite(one);
    }
}
