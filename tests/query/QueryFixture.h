/// \file
/// A library of books as a run-time metamodel, and queries over it.
#pragma once
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/query/Messages.h"
#include "tarnkiln/query/NativeTarnkilnQuery.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/RuntimeMetamodel.h"

#include <gmock/gmock.h>

#include <memory>
#include <vector>

namespace testkit {

using query::NativeTarnkilnQuery;
using query::SearchClassMatchMode;
using query::ValueMatchRelation;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;
namespace failures = tarnkiln::query;

constexpr auto EXACTLY = SearchClassMatchMode::MatchExactClass;
constexpr auto WITH_SUBCLASSES = SearchClassMatchMode::MatchSubclasses;

using Columns = std::vector<std::size_t>;
using Row = std::vector<ModelElement>;
using Rows = std::vector<Row>;

inline Rows rowsOf(query::ReflectiveQuery& query, Columns const& columns = {})
{
    Rows result;
    auto const iterator = query.getResultIterator(columns);
    for (Row row; iterator->next(row);)
        result.push_back(row);
    return result;
}

/// The elements of a query with one column.
inline Row elementsOf(query::ReflectiveQuery& query)
{
    Row result;
    for (Row const& row : rowsOf(query))
        result.push_back(row.front());
    return result;
}

/// A value that an optional property may have.
template <class T> Value optionalValue(meta::Property const& property, T const& payload)
{
    return Value(property->getType(), boost::optional<T>(payload));
}
inline Value integer(int number)
{
    return Value(StandardTypes::integerMeta, number);
}
inline Value text(ustring const& characters)
{
    return Value(StandardTypes::stringMeta, characters);
}
inline Value bytes(string const& characters)
{
    return Value(StandardTypes::stdstringMeta, characters);
}

/// Books, novels among them, and authors.
class QueryFixture : public ::testing::Test
{
protected:
    QueryFixture()
    {
        author = metamodel.makeClass(u"Author");
        book = metamodel.makeClass(u"Book");
        novel = metamodel.makeClass(u"Novel", book);
        genre = metamodel.makeEnum(u"Genre", {u"prose", u"verse"});
        name = metamodel.property(author, u"name", StandardTypes::stringMeta).required();
        born = metamodel.property(author, u"born", StandardTypes::integerMeta).required();
        title = metamodel.property(book, u"title", StandardTypes::stringMeta).required();
        pages = metamodel.property(book, u"pages", StandardTypes::integerMeta).required();
        printed = metamodel.property(book, u"printed", StandardTypes::integerMeta).required();
        shelfMark = metamodel.property(book, u"shelfMark", StandardTypes::stdstringMeta).required();
        rating = metamodel.property(book, u"rating", StandardTypes::integerMeta);
        note = metamodel.property(book, u"note", StandardTypes::stringMeta);
        kind = metamodel.property(book, u"kind", genre).required();
        mood = metamodel.property(book, u"mood", genre);
        scores = metamodel.property(book, u"scores", StandardTypes::integerMeta).many().ordered();
        writer = metamodel.property(book, u"writer", author);
        editors = metamodel.property(book, u"editors", author).many().ordered();
        parts = metamodel.property(book, u"parts", book).many().ordered().composite();
    }

    std::unique_ptr<NativeTarnkilnQuery> makeQuery() const
    {
        return query::createNativeQuery(model);
    }
    ModelElement make(meta::Class const& metaClass) const
    {
        return ModelElement::createReflective(model, metaClass);
    }
    ModelElement makeBook(ustring const& bookTitle, int pageCount = 0) const
    {
        ModelElement const made = make(book);
        set(made, title, bookTitle);
        set(made, pages, pageCount);
        return made;
    }
    ModelElement makeAuthor(ustring const& authorName, int year = 0) const
    {
        ModelElement const made = make(author);
        set(made, name, authorName);
        set(made, born, year);
        return made;
    }
    static void addTo(ModelElement const& element, meta::Property const& property,
                      ModelElement const& target)
    {
        referencesOf(element, property).getGenericInterface()->genericAdd(target);
    }
    ModelElement proxyOf(ModelElement const& target) const
    {
        return ModelElement::createProxy(model, target->getMetaClass(),
                                         target->getPersistentProxyId(/*omitModel=*/true));
    }
    ModelElement proxy(meta::Class const& metaClass, ustring const& type, ustring const& id) const
    {
        return ModelElement::createProxy(model, metaClass, ProxyId(type, id, boost::none));
    }
    /// Those of `elements` that the model has, in its own order.
    Row inOrder(Row const& elements) const
    {
        Row result;
        for (ModelElement const& element : model->getAllElements())
        {
            if (std::find(elements.begin(), elements.end(), element) != elements.end())
                result.push_back(element);
        }
        return result;
    }
    /// The books for which `property` has the relation to `value`.
    Row booksWith(meta::Property const& property, ValueMatchRelation relation,
                  Value const& value) const
    {
        auto const query = makeQuery();
        query->addSearchClass(book, WITH_SUBCLASSES);
        query->addValueConstraint(property, relation, value, 0);
        return elementsOf(*query);
    }

    RuntimeMetamodel metamodel;
    Model const model = Model::create(ModelConstellation());
    meta::Class author;
    meta::Class book;
    meta::Class novel;
    meta::Enum genre;
    meta::Property name;
    meta::Property born;
    meta::Property title;
    meta::Property pages;
    meta::Property printed;
    meta::Property shelfMark;
    meta::Property rating;
    meta::Property note;
    meta::Property kind;
    meta::Property mood;
    meta::Property scores;
    meta::Property writer;
    meta::Property editors;
    meta::Property parts;
};
}  // namespace testkit
