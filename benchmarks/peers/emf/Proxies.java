import org.eclipse.emf.common.util.URI;
import org.eclipse.emf.ecore.EObject;
import org.eclipse.emf.ecore.InternalEObject;
import org.eclipse.emf.ecore.resource.impl.ResourceSetImpl;
import org.eclipse.emf.ecore.util.EcoreUtil;

import java.util.Arrays;
import java.util.HashMap;

/** Cards that refer to books: of another resource by UUIDs, which the first read resolves. */
final class Proxies {
    private final Library library;
    private final ResourceSetImpl resources = new ResourceSetImpl();

    private Proxies(Library library) {
        this.library = library;
        library.readIds();
        resources.setURIResourceMap(new HashMap<>());  // finds resources faster
        resources.getResources().add(library.resource);
    }

    static void measure(Measure measure) {
        String resolve = "resolve a reference";
        String again = "read a resolved reference";
        String local = "read a local reference";
        if (!measure.wants(resolve) && !measure.wants(again) && !measure.wants(local))
            return;
        Proxies proxies = new Proxies(Library.filled(measure.size));
        Library.Resource catalogue = new Library.Resource(URI.createURI("books:cards"));
        proxies.resources.getResources().add(catalogue);
        EObject[] elsewhere = proxies.makeCards(catalogue);
        measure.measure(resolve, () -> {
            proxies.referByProxies(elsewhere);
            return Clock.time(() -> proxies.readAll(elsewhere)) / measure.size;
        });
        proxies.referByProxies(elsewhere);
        proxies.readAll(elsewhere);
        measure.measure(again, () -> Clock.time(() -> proxies.readAll(elsewhere)) / measure.size);
        EObject[] beside = proxies.makeCards(proxies.library.resource);
        proxies.referToBooks(beside);
        measure.measure(local, () -> Clock.time(() -> proxies.readAll(beside)) / measure.size);
    }

    private EObject[] makeCards(Library.Resource resource) {
        EObject[] cards = new EObject[library.books.length];
        for (int i = 0; i < cards.length; ++i)
            cards[i] = EcoreUtil.create(Library.CARD);
        resource.getContents().addAll(Arrays.asList(cards));
        return cards;
    }

    private void referToBooks(EObject[] cards) {
        for (int i = 0; i < cards.length; ++i)
            cards[i].eSet(Library.CARD_BOOK, library.books[i]);
    }

    private void referByProxies(EObject[] cards) {
        URI uri = library.resource.getURI();
        for (int i = 0; i < cards.length; ++i) {
            EObject proxy = EcoreUtil.create(Library.BOOK);
            ((InternalEObject) proxy).eSetProxyURI(uri.appendFragment(library.ids[i]));
            cards[i].eSet(Library.CARD_BOOK, proxy);
        }
        System.gc();  // of the proxies before
    }

    private void readAll(EObject[] cards) {
        for (int i = 0; i < cards.length; ++i)
            Measure.require(cards[i].eGet(Library.CARD_BOOK) == library.books[i], "the book");
    }
}
