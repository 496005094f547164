/// \file
/// The bodies of `BuilderValues` and `BuilderTop`, and what each kind of row does in them.
///
/// Only the source of a class includes this; see Builder.h.
#pragma once
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/support/Builder.h"
#include "tarnkiln/support/RowSteps.h"

#include <type_traits>

namespace tarn::kiln::support {

/// What a row does with the field of a builder unless its kind says otherwise: nothing.
struct NoBuilderSteps
{
    /// Sets or adds `value`; false if the field does not hold such.
    static bool take(auto& /*field*/, Value const& /*value*/) { return false; }
    /// Sets or adds a builder, which is empty then; false if the field holds no builders.
    static bool take(auto& /*field*/, std::unique_ptr<ModelElement::Builder>& /*value*/)
    {
        return false;
    }
    /// Gives a new element the value, if it touches no other element.
    static void construct(auto& /*element*/, auto const& /*field*/) {}
    /// Gives it the value if it does.
    static void connect(auto& /*element*/, auto const& /*field*/) {}
    /// Builds what the field has builders for.
    static void cascade(auto& /*element*/, auto const& /*field*/, ModelElement::Builder& /*parent*/)
    {}
};

template <class Row> struct BuilderSteps;

template <auto FIELD, Slot const& SLOT, auto SETTER>
struct BuilderSteps<Scalar<FIELD, SLOT, SETTER>> : NoBuilderSteps
{
    using NoBuilderSteps::take;

    template <class Plain> static bool take(Plain& field, Value const& value)
    {
        field = plainOf<Plain>(value);
        return true;
    }
    static void construct(FieldOwner<FIELD>& element, auto const& field) { element.*FIELD = field; }
};

template <auto FIELD, Slot const& SLOT, auto SETTER>
struct BuilderSteps<Optional<FIELD, SLOT, SETTER>> : NoBuilderSteps
{
    using NoBuilderSteps::take;

    template <class Plain> static bool take(Plain& field, Value const& value)
    {
        field = PlainField<Plain>::fromValue(value);
        return true;
    }
    static void construct(FieldOwner<FIELD>& element, auto const& field) { element.*FIELD = field; }
};

template <class Target, auto FIELD, Slot const& SLOT, auto SETTER>
struct BuilderSteps<Reference<Target, FIELD, SLOT, SETTER>> : NoBuilderSteps
{
    using Owner = FieldOwner<FIELD>;
    using NoBuilderSteps::take;

    static bool take(Target& field, Value const& value)
    {
        field = value.getValue<Target>();
        return true;
    }
    static void construct(Owner& element, Target const& field)
    {
        if (SLOT.opposite)
            return;
        element.checkCompatibleModel(field.getImpl(), SLOT);
        element.*FIELD = FieldType<FIELD>(field.getImpl());
    }
    static void connect(Owner& element, Target const& field)
    {
        if (SLOT.opposite)
            (element.*SETTER)(field);
    }
};

template <class Target, Slot const& SLOT, auto SETTER>
struct BuilderSteps<Container<Target, SLOT, SETTER>> : NoBuilderSteps
{
    using NoBuilderSteps::take;

    static bool take(Target& field, Value const& value)
    {
        field = value.getValue<Target>();
        return true;
    }
    static void connect(FieldOwner<SETTER>& element, Target const& field)
    {
        (element.*SETTER)(field);
    }
};

/// Builds what is to be contained in `element`, in the creation that `parent` takes part in.
inline ModelElement buildNested(ModelElement::Impl const& element, ModelElement::Builder& nested,
                                ModelElement::Builder& parent)
{
    parent.getOrchestrator()->addBuilder(&nested);
    if (nested.getModel().getImpl() != element.getModelImpl())
        reportException(tarnkiln::messages::CannotChangeModel());
    return nested.create();
}

template <class Target, auto FIELD, Slot const& SLOT, auto SETTER>
struct BuilderSteps<CompositeReference<Target, FIELD, SLOT, SETTER>> : NoBuilderSteps
{
    using Owner = FieldOwner<FIELD>;
    using Nested = NestedElement<Target>;
    using NoBuilderSteps::take;

    static bool take(Nested& field, Value const& value)
    {
        field = value.getValue<Target>();
        return true;
    }
    static bool take(Nested& field, std::unique_ptr<ModelElement::Builder>& value)
    {
        field = std::move(value);
        return true;
    }
    static void connect(Owner& element, Nested const& field)
    {
        if (!field.getBuilder())
            (element.*SETTER)(field.getElement());
    }
    static void cascade(Owner& element, Nested const& field, ModelElement::Builder& parent)
    {
        if (!field.getBuilder())
            return;
        ModelElement const child = buildNested(element, *field.getBuilder(), parent);
        (element.*SETTER)(Target(targetOf<Target>(child)));
    }
};

template <auto FIELD, Slot const& SLOT, auto MAKE, auto GETTER>
struct BuilderSteps<References<FIELD, SLOT, MAKE, GETTER>> : NoBuilderSteps
{
    using Owner = FieldOwner<FIELD>;
    using Collection = typename FieldType<FIELD>::Made;
    using NoBuilderSteps::connect;
    using NoBuilderSteps::take;

    static bool take(NestedBuilders& /*field*/, Value const& /*value*/) { return false; }
    static bool take(NestedBuilders& field, std::unique_ptr<ModelElement::Builder>& value)
    {
        field.push_back(std::move(value));
        return true;
    }
    template <class Target> static bool take(std::vector<Target>& field, Value const& value)
    {
        field.push_back(value.getValue<Target>());
        return true;
    }
    template <class Target> static void connect(Owner& element, std::vector<Target> const& field)
    {
        for (Target const& target : field)
            (element.*GETTER)().getGenericInterface()->genericAdd(target);
    }
    static void connect(Owner& /*element*/, NestedBuilders const& /*field*/) {}
    static void cascade(Owner& element, auto const& field, ModelElement::Builder& parent)
    {
        if constexpr (std::is_same_v<std::decay_t<decltype(field)>, NestedBuilders>)
        {
            for (std::unique_ptr<ModelElement::Builder> const& nested : field)
                contain(element, buildNested(element, *nested, parent));
        }
    }

private:
    static void contain(Owner& element, ModelElement const& child)
    {
        Collection& collection = (element.*GETTER)();
        collection.checkElementClass(child);
        ModelElement::Impl::_basicAdd(&collection, child);
        if constexpr (requires { typename Collection::key_type; })
        {
            // A map kept another one that has the same key.
            if (!collection.contains(child))
                reportException(tarnkiln::messages::UniquenessConstraint());
        }
        if (SLOT.opposite)
            element._inverseAddThis(child.getImpl(), *SLOT.opposite, /*force=*/true);
        else
            element._setContainedByThis(child.getImpl(), SLOT);
    }
};

/// Adds `value` to `collection`.
template <class T> void addValue(PrimitiveSequence<T>& collection, T const& value)
{
    collection.push_back(value);
}
template <class T> void addValue(PrimitiveSet<T>& collection, T const& value)
{
    collection.insert(value);
}

template <auto FIELD, Slot const& SLOT, auto MAKE, auto GETTER>
struct BuilderSteps<Values<FIELD, SLOT, MAKE, GETTER>> : NoBuilderSteps
{
    using NoBuilderSteps::take;

    /// All entries, if it holds several.
    template <class T> static bool take(std::vector<T>& field, Value const& value)
    {
        if (value.getFlags() < ValueFlags::Sequence)
        {
            field.push_back(plainOf<T>(value));
            return true;
        }
        std::vector<T> added;
        for (Value const& entry : value.extractEntryValues())
            added.push_back(plainOf<T>(entry));
        field.insert(field.end(), added.begin(), added.end());
        return true;
    }
    template <class T>
    static void construct(FieldOwner<FIELD>& element, std::vector<T> const& field)
    {
        // The owner's collection would announce what is filled into it.
        auto const filled = MAKE(nullptr);
        for (T const& value : field)
            addValue(*filled, value);
        auto made = MAKE(&element);
        made->basicSwapContents(*filled);
        (element.*FIELD).publish(std::move(made));
    }
};

/// Brings the rows of a class and the fields of its builder together.
template <class Rows, class Fields> struct BuilderTable;
template <class... Rows, auto... FIELDS>
struct BuilderTable<RowList<Rows...>, BuilderFields<FIELDS...>>
{
    static_assert(sizeof...(Rows) == sizeof...(FIELDS), "each row has its field");

    /// Whether `step(builderSteps, slot, field)` is true for a row; asks no further ones.
    template <class Step> static bool any([[maybe_unused]] auto& values, [[maybe_unused]] Step step)
    {
        return (step(BuilderSteps<Rows>(), Steps<Rows>::slot(), values.*FIELDS) || ...);
    }
    /// Calls it for each row whose property was given.
    template <class Step> static void eachGiven(auto& values, Step step)
    {
        ModelElement::Builder const& builder = values.getBuilder();
        [[maybe_unused]] auto const stepIfGiven = [&](auto steps, Slot const& slot, auto& field) {
            if (builder.isSet(slot.index))
                step(steps, field);
        };
        (stepIfGiven(BuilderSteps<Rows>(), Steps<Rows>::slot(), values.*FIELDS), ...);
    }
};

template <class Impl>
using BuilderTableOf = BuilderTable<typename Impl::Rows, typename Impl::BuilderImpl::Fields>;

template <class Impl, class Base>
int BuilderValues<Impl, Base>::doSetOrAdd(meta::Property const& property, Value const& value)
{
    int index = NO_SUCH_PROPERTY;
    BuilderTableOf<Impl>::any(values(), [&](auto steps, Slot const& slot, auto& field) {
        if (!isPropertyOf(slot, property) || !steps.take(field, value))
            return false;
        index = static_cast<int>(slot.index);
        return true;
    });
    return index == NO_SUCH_PROPERTY ? Base::doSetOrAdd(property, value) : index;
}

/// Whether elements that `builder` builds are of the type of `property`.
inline bool suits(ModelElement::Builder const* builder, meta::Property const& property)
{
    meta::Class const none;
    meta::Class const& metaClass = builder ? builder->getMetaClass() : none;
    return metaClass && metaClass->isA(property->getType());
}

template <class Impl, class Base>
int BuilderValues<Impl, Base>::doSetOrAdd(meta::Property const& property,
                                          std::unique_ptr<ModelElement::Builder>& value)
{
    int index = NO_SUCH_PROPERTY;
    BuilderTableOf<Impl>::any(values(), [&](auto steps, Slot const& slot, auto& field) {
        if (!isPropertyOf(slot, property) || !suits(value.get(), property) ||
            !steps.take(field, value))
            return false;
        index = static_cast<int>(slot.index);
        return true;
    });
    return index == NO_SUCH_PROPERTY ? Base::doSetOrAdd(property, value) : index;
}

template <class Impl, class Base> void BuilderValues<Impl, Base>::construct(Impl& element)
{
    BuilderTableOf<Impl>::eachGiven(
        values(), [&](auto steps, auto const& field) { steps.construct(element, field); });
}

template <class Impl, class Base> void BuilderValues<Impl, Base>::connect(Impl& element)
{
    BuilderTableOf<Impl>::eachGiven(
        values(), [&](auto steps, auto const& field) { steps.connect(element, field); });
    Base::connect(element);
}

template <class Impl, class Base> void BuilderValues<Impl, Base>::cascade(Impl& element)
{
    BuilderTableOf<Impl>::eachGiven(values(), [&](auto steps, auto const& field) {
        steps.cascade(element, field, this->getBuilder());
    });
    Base::cascade(element);
}

template <class Final>
BuilderTop<Final>::BuilderTop() : ModelElement::Builder(Final::Handle::Impl::SLOTS)
{}

template <class Final>
BuilderTop<Final>::BuilderTop(Model const& model)
    : ModelElement::Builder(model, Final::Handle::Impl::SLOTS)
{}

template <class Final>
std::unique_ptr<ModelElement::Builder> BuilderTop<Final>::instantiate(Model const& model)
{
    return std::make_unique<Final>(model);
}

template <class Final> meta::Class const& BuilderTop<Final>::getMetaClass() const
{
    return Final::Handle::metaClass();
}

template <class Final>
void BuilderTop<Final>::setOrAdd(meta::Property const& property, Value const& value)
{
    int const index = self().m_values.doSetOrAdd(property, value);
    if (index == NO_SUCH_PROPERTY)
        return ModelElement::Builder::setOrAdd(property, value);
    m_setProperties.set(static_cast<unsigned long>(index));
}

template <class Final>
void BuilderTop<Final>::setOrAdd(meta::Property const& property,
                                 std::unique_ptr<ModelElement::Builder> value)
{
    int const index = self().m_values.doSetOrAdd(property, value);
    if (index == NO_SUCH_PROPERTY)
        return ModelElement::Builder::setOrAdd(property, std::move(value));
    m_setProperties.set(static_cast<unsigned long>(index));
}

template <class Final> ModelElement BuilderTop<Final>::doCreate(bool proxy, UUID const& id)
{
    if (proxy)
    {
        ModelElement const standIn = construct(id);
        if (getOrchestrator())
            getOrchestrator()->forgetCreatedElement(this);
        return standIn;
    }
    if (getOrchestrator())
        return build(id);
    Orchestrator orchestrator(this);
    ModelElement const made = build(id);
    orchestrator.commit();
    return made;
}

/// The element with its values, not yet known to its model.
template <class Final> auto BuilderTop<Final>::construct(UUID const& id)
{
    using Handle = typename Final::Handle;
    using Impl = typename Handle::Impl;
    Impl* made = nullptr;
    if constexpr (std::is_abstract_v<Impl>)
    {
        meta::Class const& metaClass = getMetaClass();
        reportException(tarnkiln::messages::NoSuchOperation(
            u"create", metaClass ? metaClass->getQualifiedName() : ustring()));
    }
    else
        made = new Impl(self().m_values, id);
    return Handle(made);
}

/// The element that the present creation makes of this builder, made now unless it has been.
template <class Final> ModelElement BuilderTop<Final>::build(UUID const& id)
{
    if (ModelElement const present = getOrchestrator()->getCreatedElement(this))
        return present;
    auto const made = construct(id);
    made->notifyCreated();
    self().m_values.connect(*made.getImpl());
    made->cascadeCreation(self().m_values);
    return made;
}
}  // namespace tarn::kiln::support
