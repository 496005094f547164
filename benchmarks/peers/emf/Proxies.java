import org.eclipse.emf.common.util.URI;
import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.InternalEObject;
import org.eclipse.emf.ecore.resource.ResourceSet;
import org.eclipse.emf.ecore.resource.impl.ResourceSetImpl;
import org.eclipse.emf.ecore.util.EcoreUtil;

import java.util.Arrays;
import java.util.HashMap;

/** Cards that refer to books: of another resource by UUIDs, which the first read resolves. */
final class Proxies {
    private final Library library;
    private final EObject[] cards;

    private Proxies(Library library) {
        this.library = library;
        library.readIds();
        ResourceSetImpl resources = new ResourceSetImpl();
        resources.setURIResourceMap(new HashMap<>());  // finds resources faster
        resources.getResources().add(library.resource);
        cards = makeCards(resources, "books:cards");
    }

    static void measure(Measure measure) {
        String resolve = "resolve a reference";
        String again = "read a resolved reference";
        String local = "read a local reference";
        if (!measure.wants(resolve) && !measure.wants(again) && !measure.wants(local))
            return;
        Proxies proxies = new Proxies(Library.filled(measure.size));
        measure.measure(resolve, () -> {
            proxies.referByProxies();
            System.gc();  // of the round before
            return Clock.time(proxies::readAll) / measure.size;
        });
        proxies.referByProxies();
        proxies.readAll();
        measure.measure(again, () -> Clock.time(proxies::readAll) / measure.size);
        proxies.moveCards();
        measure.measure(local, () -> Clock.time(proxies::readAll) / measure.size);
    }

    private EObject[] makeCards(ResourceSet resources, String name) {
        Library.Resource catalogue = new Library.Resource(URI.createURI(name));
        resources.getResources().add(catalogue);
        EObject[] made = new EObject[library.books.length];
        for (int i = 0; i < made.length; ++i)
            made[i] = EcoreUtil.create(Library.CARD);
        catalogue.getContents().addAll(Arrays.asList(made));
        return made;
    }

    private void referByProxies() {
        URI uri = library.resource.getURI();
        for (int i = 0; i < cards.length; ++i) {
            EObject proxy = EcoreUtil.create(Library.BOOK);
            ((InternalEObject) proxy).eSetProxyURI(uri.appendFragment(library.ids[i]));
            cards[i].eSet(Library.CARD_BOOK, proxy);
        }
    }

    private void readAll() {
        for (int i = 0; i < cards.length; ++i)
            Measure.require(cards[i].eGet(Library.CARD_BOOK) == library.books[i], "the book");
    }

    /** Puts the cards beside the books that they refer to. */
    private void moveCards() {
        library.resource.getContents().addAll(Arrays.asList(cards));
    }
}
