/// \file
/// The kinds of collections that the contracts of collections are tried on.
///
/// A kind says where an element has its collection, what goes in, and what is in there:
///
/// | Member | Says |
/// |---|---|
/// | `Collection`, `Owner`, `Entry` | the types of the collection, the element and what goes in |
/// | `owner(model)` | makes an element that has such a collection |
/// | `of(owner)` | its collection |
/// | `entry(model, i)` | makes something to add; entries of different numbers differ |
/// | `add`, `remove` | a public change, by the type of the collection |
/// | `contents(collection)` | what is in there, to be compared |
/// | `snapshot()` | a collection of that class without an owner |
/// | `proxy(model, id)` | something to add to a collection of elements that stands for another |
/// | `NAME` | in the report of the tests |
#pragma once
#include "tests/collections/CollectionFixture.h"

#include <algorithm>
#include <memory>
#include <string>
#include <type_traits>
#include <vector>

namespace testkit {

inline ustring letter(int number)
{
    return ustring(1, static_cast<char16_t>(u'a' + number));
}

/// What goes into collections of `T`; specialised for the types of a metamodel.
template <class T> struct Entries
{
    static T make(Model const& model, int number)
    {
        T const made = T::create(model);
        made->setName(letter(number));
        return made;
    }
};
template <> struct Entries<int>
{
    static int make(Model const&, int number) { return number; }
};
template <> struct Entries<ustring>
{
    static ustring make(Model const&, int number) { return letter(number); }
};

template <class C> struct EntryOf
{
    using type = typename C::value_type;
};
template <class C>
requires requires
{
    typename C::mapped_type;
}
struct EntryOf<C>
{
    using type = typename C::mapped_type;
};

/// Sorted for what has no positions, whose order says nothing.
inline std::vector<ModelElement> contentsOf(ReferenceCollection const& collection)
{
    std::vector<ModelElement> result = collection.getAllValuesAndProxies();
    if (!collection.getGenericInterface()->isSequenceInterface())
        std::sort(result.begin(), result.end(), [](auto const& left, auto const& right) {
            return left.getImpl() < right.getImpl();
        });
    return result;
}
template <class C>
requires std::is_base_of_v<AbstractPrimitiveCollection, C>
auto contentsOf(C const& collection)
{
    return std::vector<typename C::value_type>(collection.begin(), collection.end());
}

/// The key of an element of class `T`.
template <class T> ustring nameOf(ModelElement::Impl* member)
{
    return static_cast<typename T::Impl*>(member)->getName();
}

template <class Getter> struct Gotten;
template <class C, class Impl> struct Gotten<C& (Impl::*)() const>
{
    using Collection = C;
    using Owner = typename Impl::Handle;
};

/// A property of a class that has C++ code.
///
/// \tparam ARGUMENTS  of the collection's constructor, between owner and slot.
template <auto GETTER, Slot const& SLOT, auto... ARGUMENTS> struct PropertyKind
{
    using Collection = typename Gotten<decltype(GETTER)>::Collection;
    using Owner = typename Gotten<decltype(GETTER)>::Owner;
    using Entry = typename EntryOf<Collection>::type;
    static constexpr bool IS_GIVEN_BY_SLOT = true;

    static Owner owner(Model const& model) { return Owner::create(model); }
    static Collection& of(Owner const& element) { return (element.getImpl()->*GETTER)(); }
    static Entry entry(Model const& model, int number)
    {
        return Entries<Entry>::make(model, number);
    }
    static void add(Collection& collection, Entry const& entry)
    {
        if constexpr (requires { collection.push_back(entry); })
            collection.push_back(entry);
        else
            collection.insert(entry);
    }
    static void remove(Collection& collection, Entry const& entry)
    {
        if constexpr (requires { collection.push_back(entry); })
            collection.remove(entry);
        else
            collection.erase(entry);
    }
    static auto contents(Collection const& collection) { return contentsOf(collection); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, ARGUMENTS..., SLOT);
    }
    static Entry proxy(Model const& model, ProxyId const& id)
    {
        if constexpr (requires { Entry::createProxy(model, id); })
            return Entry::createProxy(model, id);
        else
            return Entry::cast(ModelElement::createProxy(model, Entry::metaClass(), id));
    }
};

/// \name Those of hand-written classes
/// @{
struct Numbers : PropertyKind<&Node::Impl::getNumbers, Node::Impl::NUMBERS, false>
{
    static constexpr char const* NAME = "Numbers";
};
struct Labels : PropertyKind<&Node::Impl::getLabels, Node::Impl::LABELS, true>
{
    static constexpr char const* NAME = "Labels";
};
struct Words : PropertyKind<&Node::Impl::getWords, Node::Impl::WORDS>
{
    static constexpr char const* NAME = "Words";
};
struct Owned : PropertyKind<&Node::Impl::getOwned, Node::Impl::OWNED, true>
{
    static constexpr char const* NAME = "Owned";
};
struct Links : PropertyKind<&Node::Impl::getLinks, Node::Impl::LINKS, true>
{
    static constexpr char const* NAME = "Links";
};
struct Backlinks : PropertyKind<&Node::Impl::getBacklinks, Node::Impl::BACKLINKS, true>
{
    static constexpr char const* NAME = "Backlinks";
};
struct Children : PropertyKind<&Node::Impl::getChildren, Node::Impl::CHILDREN, true>
{
    static constexpr char const* NAME = "Children";
};
struct Parts : PropertyKind<&Node::Impl::getParts, Node::Impl::PARTS, false>
{
    static constexpr char const* NAME = "Parts";
};
struct Marks : PropertyKind<&Node::Impl::getMarks, Node::Impl::MARKS>
{
    static constexpr char const* NAME = "Marks";
};
struct MarkedBy : PropertyKind<&Node::Impl::getMarkedBy, Node::Impl::MARKED_BY>
{
    static constexpr char const* NAME = "MarkedBy";
};
struct ByName : PropertyKind<&Node::Impl::getByName, Node::Impl::BY_NAME, &nameOf<Node>>
{
    static constexpr char const* NAME = "ByName";
};
struct Grouped : PropertyKind<&Node::Impl::getGrouped, Node::Impl::GROUPED, &nameOf<Node>>
{
    static constexpr char const* NAME = "Grouped";
};
/// @}

/// Links to what is not there.
struct LinksToNothing : Links
{
    static constexpr char const* NAME = "LinksToNothing";

    static Entry entry(Model const& model, int number)
    {
        return Node::createProxy(model, ProxyId(ElementId::UUID_TYPE, letter(number)));
    }
};

/// Names the kinds for the report of the tests.
class KindNames
{
public:
    template <class Kind> static std::string GetName(int /*index*/) { return Kind::NAME; }
};
}  // namespace testkit
