/// \file
/// Books and their authors as plain structs, for the floor of what any library can reach.
#pragma once
#include "tarnkiln/kernel/Types.h"

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

namespace peers {

struct PlainAuthor;

/// What reads the pages by a virtual call.
struct WithPages
{
    virtual int getPages() const = 0;

protected:
    ~WithPages() = default;
};

struct PlainBook final : WithPages
{
    int getPages() const override;

    std::u16string title;
    int pages = 0;
    double price = 0;
    PlainAuthor* author = nullptr;
    PlainBook* next = nullptr;
    PlainBook* previous = nullptr;
};

struct PlainAuthor
{
    std::u16string name;
    std::vector<PlainBook*> books;
};

/// Books that stand in their hash table by UUID, and their order.
class PlainLibrary
{
public:
    using UUID = tarn::kiln::UUID;

    explicit PlainLibrary(std::vector<std::u16string> titles);
    PlainLibrary(PlainLibrary const&) = delete;
    PlainLibrary& operator=(PlainLibrary const&) = delete;

    /// The work of the workload "create".
    void fill();
    /// Ends the life of all books and authors.
    void clear();

    PlainBook const* find(UUID const& id) const;
    /// The books as what is read by virtual calls.
    std::vector<WithPages*> booksWithPages() const { return {books.begin(), books.end()}; }

    std::vector<PlainBook*> books;
    std::vector<UUID> ids;

private:
    /// UUIDs are random already.
    struct FirstBytes
    {
        std::size_t operator()(UUID const& id) const noexcept;
    };

    UUID makeId();
    PlainAuthor* addAuthor(std::size_t number);

    std::vector<std::u16string> const m_titles;
    std::unordered_map<UUID, PlainBook, FirstBytes> m_bookOf;
    std::unordered_map<UUID, PlainAuthor, FirstBytes> m_authorOf;
    std::uint64_t m_random = 1;
};
}  // namespace peers
