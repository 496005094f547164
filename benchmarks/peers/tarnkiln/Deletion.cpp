#include "benchmarks/peers/tarnkiln/Workloads.h"

namespace peers {

void measureDeletion(Measure const& measure)
{
    measure.ours("delete every second book", [&] {
        Library library(measure.size());
        library.fill();
        std::size_t const before = library.model->getElementCount();
        std::size_t const gone = measure.size() / 2;
        double const taken = Measure::time([&] {
            library.change(/*revertible=*/false, [&] {
                for (std::size_t i = 1; i < measure.size(); i += 2)
                    library.books[i]->destroy();
            });
        });
        Measure::require(library.model->getElementCount() == before - gone, "half of the books");
        return taken / static_cast<double>(gone);
    });
}
}  // namespace peers
