/// \file
/// The kinds of collections that reflective elements have. Their class is that of nodes.
#pragma once
#include "tarnkiln/collections/ReflectiveElementSequence.h"
#include "tarnkiln/collections/ReflectiveKeyedCollection.h"
#include "tarnkiln/collections/ReflectiveUnorderedElementSet.h"
#include "tests/contract/CollectionKinds.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/RuntimeMetamodel.h"

#include <memory>

namespace testkit {

inline ModelElement makeReflectiveNode(Model const& model)
{
    return ModelElement::createReflective(model, NodeMetamodel::get().node);
}

template <class Base, Slot const& SLOT> struct ReflectiveValues : Base
{
    using typename Base::Collection;
    using Owner = ModelElement;
    static constexpr bool IS_GIVEN_BY_SLOT = false;

    static Owner owner(Model const& model) { return makeReflectiveNode(model); }
    static Collection& of(ModelElement const& element)
    {
        return dynamic_cast<Collection&>(valuesOf(element, SLOT.property()));
    }
};

struct ReflectiveNumbers : ReflectiveValues<Numbers, Node::Impl::NUMBERS>
{
    static constexpr char const* NAME = "Numbers";
};
struct ReflectiveLabels : ReflectiveValues<Labels, Node::Impl::LABELS>
{
    static constexpr char const* NAME = "Labels";
};
struct ReflectiveWords : ReflectiveValues<Words, Node::Impl::WORDS>
{
    static constexpr char const* NAME = "Words";
};

inline ustring reflectiveNameOf(ModelElement::Impl* member)
{
    return get<ustring>(ModelElement(member), Node::Impl::NAME.property());
}

/// \tparam ARGUMENTS  of the collection's constructor, between class and property.
template <class C, Slot const& SLOT, auto... ARGUMENTS> struct ReflectiveReferences
{
    using Collection = C;
    using Owner = ModelElement;
    using Entry = ModelElement;
    static constexpr bool IS_GIVEN_BY_SLOT = false;

    static Owner owner(Model const& model) { return makeReflectiveNode(model); }
    static Collection& of(ModelElement const& element)
    {
        return dynamic_cast<Collection&>(referencesOf(element, SLOT.property()));
    }
    static Entry entry(Model const& model, int number)
    {
        ModelElement const made = makeReflectiveNode(model);
        set(made, Node::Impl::NAME.property(), letter(number));
        return made;
    }
    static void add(C& collection, Entry const& entry)
    {
        collection.getGenericInterface()->genericAdd(entry);
    }
    static void remove(C& collection, Entry const& entry)
    {
        collection.getGenericInterface()->genericRemove(entry);
    }
    static auto contents(Collection const& collection) { return contentsOf(collection); }
    static std::unique_ptr<C> snapshot()
    {
        return std::make_unique<C>(nullptr, NodeMetamodel::get().node, ARGUMENTS...,
                                   SLOT.property().getImpl(),
                                   SLOT.opposite ? SLOT.opposite->property().getImpl() : nullptr);
    }
    static Entry proxy(Model const& model, ProxyId const& id)
    {
        return ModelElement::createProxy(model, NodeMetamodel::get().node, id);
    }
};

struct ReflectiveOwned : ReflectiveReferences<ReflectiveElementSequence, Node::Impl::OWNED, true>
{
    static constexpr char const* NAME = "Owned";
};
struct ReflectiveLinks : ReflectiveReferences<ReflectiveElementSequence, Node::Impl::LINKS, true>
{
    static constexpr char const* NAME = "Links";
};
struct ReflectiveChildren
    : ReflectiveReferences<ReflectiveElementSequence, Node::Impl::CHILDREN, true>
{
    static constexpr char const* NAME = "Children";
};
struct ReflectiveParts : ReflectiveReferences<ReflectiveElementSequence, Node::Impl::PARTS, false>
{
    static constexpr char const* NAME = "Parts";
};
struct ReflectiveMarks : ReflectiveReferences<ReflectiveUnorderedElementSet, Node::Impl::MARKS>
{
    static constexpr char const* NAME = "Marks";
};
struct ReflectiveByName
    : ReflectiveReferences<ReflectiveElementMap<ustring>, Node::Impl::BY_NAME, &reflectiveNameOf>
{
    static constexpr char const* NAME = "ByName";
};
struct ReflectiveGrouped : ReflectiveReferences<ReflectiveElementMultimap<ustring>,
                                                Node::Impl::GROUPED, &reflectiveNameOf>
{
    static constexpr char const* NAME = "Grouped";
};
}  // namespace testkit
