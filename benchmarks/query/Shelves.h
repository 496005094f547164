/// \file
/// Models of books, writers and publishers, for the measurements of queries.
#pragma once
#include "shelves/BookImpl.h"
#include "shelves/PublisherImpl.h"
#include "shelves/WriterImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"

#include <cstdint>
#include <vector>

namespace benchkit {

using namespace tarn::kiln;
using shelves::Book;
using shelves::Publisher;
using shelves::Writer;

/// A model with `count` books, a writer for ten of them and a publisher for ten of those.
///
/// The pages of books go from 0 to 999, evenly, and a title says whether a book is among the 1 % or
/// the 50 % that have most of them: "the book with the number 17 is rare and sought", "is sought"
/// or "is at hand".
class Shelves
{
public:
    explicit Shelves(std::int64_t count);

    /// The model of that size, made once and never destroyed.
    static Shelves const& get(std::int64_t count);
    /// The number of pages that so many percent of the books exceed; 1 or 50.
    static int boundFor(std::int64_t percent) { return percent == 1 ? 989 : 499; }

    Model const model = Model::create(ModelConstellation());
    /// All of each class, in the order of the model, as queries meet them.
    std::vector<Book> books;
    std::vector<Writer> writers;
    std::vector<Publisher> publishers;

private:
    Publisher makePublisher(std::int64_t number) const;
    Writer makeWriter(std::int64_t number, Publisher const& publisher) const;
    void makeBook(std::int64_t number, Writer const& writer) const;
};
}  // namespace benchkit
