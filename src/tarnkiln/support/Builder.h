/// \file
/// What the builders of all generated classes are made of.
///
/// A builder has two halves. `C::Impl::BuilderImpl` keeps the values, and extends that of the
/// superclass; `C::Impl::BuilderBase<Final>` has the functions that set them and return the
/// builder, and extends that of the superclass too:
///
///     ModelElement::Builder              BuilderRoot
///     BuilderTop<Final>                  BuilderValues<S::Impl, BuilderRoot>
///     S::Impl::BuilderBase<Final>        S::Impl::BuilderImpl
///     C::Impl::BuilderBase<Final>        BuilderValues<C::Impl, S::Impl::BuilderImpl>
///     C::Builder                         C::Impl::BuilderImpl, a field of C::Builder
#pragma once
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/support/Rows.h"

#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln::support {

/// The builders of what a many-valued composite property is to hold.
using NestedBuilders = std::vector<std::unique_ptr<ModelElement::Builder>>;

/// What a single composite property is to hold: an element, or the builder of one.
template <class Target> class NestedElement
{
public:
    Target const& getElement() const { return m_element; }
    /// Null if it holds an element, or nothing.
    ModelElement::Builder* getBuilder() const { return m_builder.get(); }

    NestedElement& operator=(Target const& element)
    {
        m_element = element;
        m_builder.reset();
        return *this;
    }
    NestedElement& operator=(std::unique_ptr<ModelElement::Builder> builder)
    {
        m_element = Target();
        m_builder = std::move(builder);
        return *this;
    }

private:
    Target m_element;
    std::unique_ptr<ModelElement::Builder> m_builder;
};

/// Adds a builder; null is ignored.
inline void addNested(NestedBuilders& builders, std::unique_ptr<ModelElement::Builder> added)
{
    if (added)
        builders.push_back(std::move(added));
}

/// Points to the fields of a `BuilderImpl`, one for each of the class's rows, in their order.
///
/// | Row | Field |
/// |---|---|
/// | `Scalar`, `Optional` | the value, as in the element |
/// | `Reference`, `Container` | a handle |
/// | `CompositeReference` | a `NestedElement` |
/// | `References` | `NestedBuilders` if it is composite, else a vector of handles |
/// | `Values` | a vector of values |
template <auto... FIELDS> struct BuilderFields
{};

/// Stands for the index of a property that a class does not have.
constexpr int NO_SUCH_PROPERTY = -1;

/// Where the values of the classes without superclass end: what nobody answered, nobody knows.
class TARNKILN_EXPORT BuilderRoot
{
public:
    explicit BuilderRoot(ModelElement::Builder& builder) : m_builder(builder) {}
    BuilderRoot(BuilderRoot const&) = delete;
    BuilderRoot& operator=(BuilderRoot const&) = delete;

    /// The builder whose values these are.
    ModelElement::Builder& getBuilder() const { return m_builder; }

    int doSetOrAdd(meta::Property const&, Value const&) { return NO_SUCH_PROPERTY; }
    int doSetOrAdd(meta::Property const&, std::unique_ptr<ModelElement::Builder>&)
    {
        return NO_SUCH_PROPERTY;
    }
    void connect(ModelElement::Impl&) {}
    void cascade(ModelElement::Impl&) {}

protected:
    ~BuilderRoot() = default;

private:
    ModelElement::Builder& m_builder;
};

/// Brings the values for the properties of one class, `Impl`, from and to where its rows say.
///
/// `Impl::BuilderImpl` supplies `Fields`, the `BuilderFields` of the class's own properties. What
/// is none of them goes to `Base`, the values of the superclass. Only what was given counts: for
/// all else the element keeps its initial value.
///
/// Instantiated in the source of the class, which includes BuilderSteps.h.
template <class Impl, class Base> class TARNKILN_EXPORT BuilderValues : public Base
{
public:
    using Base::Base;

    /// Sets or adds a plain value or an element. The index of the property; `NO_SUCH_PROPERTY` if
    /// neither the class nor a superclass has it.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if the value is of another type.
    int doSetOrAdd(meta::Property const& property, Value const& value);
    /// The same for a composite property and the builder of what it is to hold, which is taken if
    /// there is such a property and its type suits.
    int doSetOrAdd(meta::Property const& property, std::unique_ptr<ModelElement::Builder>& value);

    /// Gives a new element the values that touch no other element.
    void construct(Impl& element);
    /// Gives it, once its model knows it, the references that have another end. Those of the
    /// superclasses too.
    void connect(Impl& element);
    /// Builds what its composite properties hold, in the order of the properties; then those of the
    /// superclasses.
    void cascade(Impl& element);

private:
    auto& values() { return static_cast<typename Impl::BuilderImpl&>(*this); }
};

/// What the builders of all classes do alike. `Final` is the builder, `Final::Handle` its class.
template <class Final> class TARNKILN_EXPORT BuilderTop : public ModelElement::Builder
{
public:
    /// For a nested builder.
    BuilderTop();
    explicit BuilderTop(Model const& model);

    /// A new builder, for the registry of types.
    static std::unique_ptr<ModelElement::Builder> instantiate(Model const& model);

    // ModelElement::Builder
    meta::Class const& getMetaClass() const override;
    void setOrAdd(meta::Property const& property, Value const& value) override;
    void setOrAdd(meta::Property const& property,
                  std::unique_ptr<ModelElement::Builder> value) override;

protected:
    // ModelElement::Builder
    ModelElement doCreate(bool proxy, UUID const& id) override;

    /// Hands `argument` to `take`, a function of the values, and marks the property as given.
    template <class Values, class Parameter, class Argument>
    Final& give(Slot const& slot, void (Values::*take)(Parameter), Argument&& argument)
    {
        (self().m_values.*take)(std::forward<Argument>(argument));
        return given(slot);
    }
    /// The same for each of several.
    template <class Values, class Parameter, class Argument>
    Final& giveEach(Slot const& slot, void (Values::*take)(Parameter),
                    std::initializer_list<Argument> arguments)
    {
        for (Argument const& argument : arguments)
            (self().m_values.*take)(argument);
        return given(slot);
    }
    /// The same for a function without argument.
    template <class Values> Final& give(Slot const& slot, void (Values::*clear)())
    {
        (self().m_values.*clear)();
        return given(slot);
    }

private:
    Final& self() { return static_cast<Final&>(*this); }
    Final& given(Slot const& slot)
    {
        m_setProperties.set(slot.index);
        return self();
    }
    auto construct(UUID const& id);
    ModelElement build(UUID const& id);
};
}  // namespace tarn::kiln::support
