#include "benchmarks/peers/tarnkiln/PlainLibrary.h"

#include "benchmarks/peers/tarnkiln/Library.h"
#include "tarnkiln/kernel/Text.h"

#include <cstring>

namespace peers {

int PlainBook::getPages() const
{
    return pages;
}

PlainLibrary::PlainLibrary(std::vector<std::u16string> titles) : m_titles(std::move(titles))
{
    books.reserve(m_titles.size());
    ids.reserve(m_titles.size());
}

void PlainLibrary::fill()
{
    PlainAuthor* author = nullptr;
    for (std::size_t i = 0; i < m_titles.size(); ++i)
    {
        if (i % Library::BOOKS_PER_AUTHOR == 0)
            author = addAuthor(i / Library::BOOKS_PER_AUTHOR);
        UUID const id = makeId();
        PlainBook& book = m_bookOf[id];
        book.title = m_titles[i];
        book.pages = Library::pages(i, /*turn=*/0);
        book.price = 0.5 * static_cast<double>(i);
        book.author = author;
        author->books.push_back(&book);
        if (i > 0)
        {
            book.previous = books.back();
            books.back()->next = &book;
        }
        books.push_back(&book);
        ids.push_back(id);
    }
}

void PlainLibrary::clear()
{
    m_bookOf.clear();
    m_authorOf.clear();
}

PlainBook const* PlainLibrary::find(UUID const& id) const
{
    auto const found = m_bookOf.find(id);
    return found == m_bookOf.end() ? nullptr : &found->second;
}

std::size_t PlainLibrary::FirstBytes::operator()(UUID const& id) const noexcept
{
    std::size_t hash = 0;
    std::memcpy(&hash, &id, sizeof hash);
    return hash;
}

PlainLibrary::UUID PlainLibrary::makeId()
{
    UUID id;
    for (std::size_t at = 0; at < sizeof id; at += sizeof m_random)
    {
        m_random = (m_random ^ (m_random >> 29)) * 0x9E3779B97F4A7C15 + 1;
        std::memcpy(reinterpret_cast<char*>(&id) + at, &m_random, sizeof m_random);
    }
    return id;
}

PlainAuthor* PlainLibrary::addAuthor(std::size_t number)
{
    PlainAuthor& author = m_authorOf[makeId()];
    author.name = u"Author " + tarn::kiln::toUstring(std::to_string(number));
    return &author;
}
}  // namespace peers
