// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `Property`.
#pragma once
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/StructuredType.h"
#include "tarnkiln/meta/TypedElementImpl.h"
#include "tarnkiln/support/Dispatch.h"

#include <boost/optional.hpp>

namespace tarn::kiln::meta {

/// The properties of a `Property`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Property::Impl
    : public support::Dispatched<Property::Impl, TypedElement::Impl>
{
public:
    class BuilderImpl;                         // PropertyBuilder.h
    template <class Final> class BuilderBase;  // PropertyBuilder.h

    using Handle = Property;
    using Storage = support::Record<Impl, TypedElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 26;
    static Slot const IS_DERIVED;
    static Slot const IS_COMPOSITE;
    static Slot const IS_READ_ONLY;
    static Slot const IS_UNIQUE;
    static Slot const QUALIFIED_BY;
    static Slot const CUSTOM_QUALIFICATION;
    static Slot const IS_QUALIFICATION_UNIQUE;
    static Slot const OPPOSITE;
    static Slot const PROPERTY_INDEX;
    static Slot const IS_PUBLIC_ACCESSOR;
    static Slot const IS_PUBLIC_MUTATOR;
    static Slot const IS_TRANSIENT;
    static Slot const IS_SPARSE;
    static Slot const OWNING_TYPE;
    static Slot const VOBJ_DISP_CATEGORY;
    static Slot const VOBJ_DISP_SKIP_EMPTY;
    static Slot const IS_SET_ONCE;
    static Slot const IS_VOBJ_HIDDEN;
    static Slot const DEFAULT_VALUE;
    static Slot const IS_QUERY_INDEX;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// Whether the value is computed and has no slot.
    bool isDerived() const { return m_isDerived; }
    void setIsDerived(bool derived);

    /// Whether the value is contained in the element.
    bool isComposite() const { return m_isComposite; }
    void setIsComposite(bool composite);

    /// Whether there is no setter.
    bool isReadOnly() const { return m_isReadOnly; }
    void setIsReadOnly(bool readOnly);

    /// Whether a sequence refuses to hold a member twice.
    bool isUnique() const { return m_isUnique; }
    void setIsUnique(bool unique);

    /// The property of the members that is the key of this collection.
    Property getQualifiedBy() const;
    /// Null if there is none; a proxy stays one.
    Property::Impl* getQualifiedByImpl() const { return m_qualifiedBy.get(); }
    /// Whether there is one and it is live.
    bool hasQualifiedBy() const;
    void setQualifiedBy(Property const& qualifiedBy);

    /// Whether a client's code keeps the keys current.
    bool getCustomQualification() const { return m_customQualification; }
    void setCustomQualification(bool customQualification);

    /// Whether a key has one member at most.
    bool isQualificationUnique() const { return m_isQualificationUnique; }
    void setIsQualificationUnique(bool qualificationUnique);

    /// The other end of the association.
    Property getOpposite() const;
    /// Null if there is none; a proxy stays one.
    Property::Impl* getOppositeImpl() const { return m_opposite.get(); }
    /// Whether there is one and it is live.
    bool hasOpposite() const;
    void setOpposite(Property const& opposite);

    /// The slot, counted from 1; 0 if there is none.
    int getPropertyIndex() const { return m_propertyIndex; }
    void setPropertyIndex(int propertyIndex);

    /// Whether any client may read it.
    bool isPublicAccessor() const { return m_isPublicAccessor; }
    void setIsPublicAccessor(bool publicAccessor);

    /// Whether any client may change it.
    bool isPublicMutator() const { return m_isPublicMutator; }
    void setIsPublicMutator(bool publicMutator);

    /// Whether documents leave it out.
    bool isTransient() const { return m_isTransient; }
    void setIsTransient(bool transient);

    /// Whether most elements have no value.
    bool isSparse() const { return m_isSparse; }
    void setIsSparse(bool sparse);

    /// The type that has it.
    StructuredType getOwningType() const;
    StructuredType::Impl* getOwningTypeImpl() const;
    /// Whether there is one and it is live.
    bool hasOwningType() const;
    void setOwningType(StructuredType const& owningType);

    /// The display group.
    boost::optional<string> const& getVobjDispCategory() const { return m_vobjDispCategory; }
    void setVobjDispCategory(boost::optional<string> const& vobjDispCategory);

    /// Whether displays leave out an empty value.
    bool getVobjDispSkipEmpty() const { return m_vobjDispSkipEmpty; }
    void setVobjDispSkipEmpty(bool vobjDispSkipEmpty);

    /// Whether it may be set once, from the empty value.
    bool isSetOnce() const { return m_isSetOnce; }
    void setIsSetOnce(bool setOnce);

    /// Whether displays leave it out.
    bool isVobjHidden() const { return m_isVobjHidden; }
    void setIsVobjHidden(bool vobjHidden);

    /// The text of the value that new elements start with.
    boost::optional<ustring> const& getDefaultValue() const { return m_defaultValue; }
    void setDefaultValue(boost::optional<ustring> const& defaultValue);

    /// Whether queries ask for it often.
    bool isQueryIndex() const { return m_isQueryIndex; }
    void setIsQueryIndex(bool queryIndex);

    /// Gives it another name, under which the owner then keeps it.
    ///
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such name.
    void setName(ustring const& name) override;

    /// The owner's qualified name, a dot and the name; the name alone without an owner.
    ustring identifier() const override;

    /// Whether `defaultValue` computes another value at each call: a random UUID, the present time.
    bool isDynamicDefault() const;

    /// The value that new elements start with; absent if there is no text for it. A text may be
    /// in any flavour of the type. For an enumeration it is the name of a literal, and "random" is
    /// a new UUID, "now" the local time in whole seconds.
    ///
    /// None for many values, without a live type, for classes, data types and `HostArray`, if no
    /// flavour can read the text, and if the type has no absent value.
    boost::optional<Value> defaultValue() const;

private:
    bool m_isDerived = false;
    bool m_isComposite = false;
    bool m_isReadOnly = false;
    bool m_isUnique = false;
    mutable support::CountedPointer<Property::Impl> m_qualifiedBy;
    bool m_customQualification = false;
    bool m_isQualificationUnique = true;
    mutable support::CountedPointer<Property::Impl> m_opposite;
    int m_propertyIndex = 0;
    bool m_isPublicAccessor = true;
    bool m_isPublicMutator = true;
    bool m_isTransient = false;
    bool m_isSparse = false;
    boost::optional<string> m_vobjDispCategory;
    bool m_vobjDispSkipEmpty = false;
    bool m_isSetOnce = false;
    bool m_isVobjHidden = false;
    boost::optional<ustring> m_defaultValue;
    bool m_isQueryIndex = false;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_isDerived, IS_DERIVED, &Impl::setIsDerived>,
        support::Scalar<&Impl::m_isComposite, IS_COMPOSITE, &Impl::setIsComposite>,
        support::Scalar<&Impl::m_isReadOnly, IS_READ_ONLY, &Impl::setIsReadOnly>,
        support::Scalar<&Impl::m_isUnique, IS_UNIQUE, &Impl::setIsUnique>,
        support::Reference<Property, &Impl::m_qualifiedBy, QUALIFIED_BY, &Impl::setQualifiedBy>,
        support::Scalar<
            &Impl::m_customQualification, CUSTOM_QUALIFICATION, &Impl::setCustomQualification>,
        support::Scalar<
            &Impl::m_isQualificationUnique, IS_QUALIFICATION_UNIQUE,
            &Impl::setIsQualificationUnique>,
        support::Reference<Property, &Impl::m_opposite, OPPOSITE, &Impl::setOpposite>,
        support::Scalar<&Impl::m_propertyIndex, PROPERTY_INDEX, &Impl::setPropertyIndex>,
        support::Scalar<&Impl::m_isPublicAccessor, IS_PUBLIC_ACCESSOR, &Impl::setIsPublicAccessor>,
        support::Scalar<&Impl::m_isPublicMutator, IS_PUBLIC_MUTATOR, &Impl::setIsPublicMutator>,
        support::Scalar<&Impl::m_isTransient, IS_TRANSIENT, &Impl::setIsTransient>,
        support::Scalar<&Impl::m_isSparse, IS_SPARSE, &Impl::setIsSparse>,
        support::Container<StructuredType, OWNING_TYPE, &Impl::setOwningType>,
        support::Optional<
            &Impl::m_vobjDispCategory, VOBJ_DISP_CATEGORY, &Impl::setVobjDispCategory>,
        support::Scalar<
            &Impl::m_vobjDispSkipEmpty, VOBJ_DISP_SKIP_EMPTY, &Impl::setVobjDispSkipEmpty>,
        support::Scalar<&Impl::m_isSetOnce, IS_SET_ONCE, &Impl::setIsSetOnce>,
        support::Scalar<&Impl::m_isVobjHidden, IS_VOBJ_HIDDEN, &Impl::setIsVobjHidden>,
        support::Optional<&Impl::m_defaultValue, DEFAULT_VALUE, &Impl::setDefaultValue>,
        support::Scalar<&Impl::m_isQueryIndex, IS_QUERY_INDEX, &Impl::setIsQueryIndex>>;
};

inline Property::Property(Impl* impl) : TypedElement(impl) {}
inline Property::Impl* Property::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Property::Impl* Property::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Property::Impl, tarn::kiln::meta::TypedElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Property::Impl, tarn::kiln::meta::TypedElement::Impl>;
