#include "benchmarks/query/Shelves.h"

#include "tarnkiln/kernel/Text.h"

#include <map>
#include <string>

namespace benchkit {

Shelves::Shelves(std::int64_t count)
{
    Publisher publisher;
    Writer writer;
    for (std::int64_t i = 0; i < count; ++i)
    {
        if (i % 100 == 0)
            publisher = makePublisher(i / 100);
        if (i % 10 == 0)
            writer = makeWriter(i / 10, publisher);
        makeBook(i, writer);
    }
    for (ModelElement const& element : model->getAllElements())
    {
        if (Book const book = Book::cast(element))
            books.push_back(book);
        else if (Writer const written = Writer::cast(element))
            writers.push_back(written);
        else
            publishers.push_back(Publisher::cast(element));
    }
}

Shelves const& Shelves::get(std::int64_t count)
{
    // Elements would outlive what the end of a program destroys.
    static auto& all = *new std::map<std::int64_t, Shelves>;
    return all.try_emplace(count, count).first->second;
}

Publisher Shelves::makePublisher(std::int64_t number) const
{
    Publisher const made = Publisher::create(model);
    made->setName(toUstring("publisher " + std::to_string(number)));
    return made;
}

Writer Shelves::makeWriter(std::int64_t number, Publisher const& publisher) const
{
    Writer const made = Writer::create(model);
    made->setName(toUstring("the writer with the number " + std::to_string(number)));
    made->setPublisher(publisher);
    return made;
}

void Shelves::makeBook(std::int64_t number, Writer const& writer) const
{
    int const pages = static_cast<int>(number * 7919 % 1000);
    char const* const fame = pages > boundFor(1)    ? "rare and sought"
                             : pages > boundFor(50) ? "sought"
                                                    : "at hand";
    Book const made = Book::create(model);
    made->setTitle(toUstring("the book with the number " + std::to_string(number) + " is " + fame));
    made->setPages(pages);
    made->setWriterName(writer->getName());
    made->setWriter(writer);
}
}  // namespace benchkit
