// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Property` and makes it.
#pragma once
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/TypedElementBuilder.h"

namespace tarn::kiln::meta {

/// The values of a `Property` to be.
class TARNKILN_EXPORT Property::Impl::BuilderImpl
    : public support::BuilderValues<Property::Impl, TypedElement::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetIsDerived(bool derived) { m_isDerived = derived; }
    void doSetIsComposite(bool composite) { m_isComposite = composite; }
    void doSetIsReadOnly(bool readOnly) { m_isReadOnly = readOnly; }
    void doSetIsUnique(bool unique) { m_isUnique = unique; }
    void doSetQualifiedBy(Property const& qualifiedBy) { m_qualifiedBy = qualifiedBy; }
    void doSetCustomQualification(bool customQualification)
    {
        m_customQualification = customQualification;
    }
    void doSetIsQualificationUnique(bool qualificationUnique)
    {
        m_isQualificationUnique = qualificationUnique;
    }
    void doSetOpposite(Property const& opposite) { m_opposite = opposite; }
    void doSetPropertyIndex(int propertyIndex) { m_propertyIndex = propertyIndex; }
    void doSetIsPublicAccessor(bool publicAccessor) { m_isPublicAccessor = publicAccessor; }
    void doSetIsPublicMutator(bool publicMutator) { m_isPublicMutator = publicMutator; }
    void doSetIsTransient(bool transient) { m_isTransient = transient; }
    void doSetIsSparse(bool sparse) { m_isSparse = sparse; }
    void doSetOwningType(StructuredType const& owningType) { m_owningType = owningType; }
    void doSetVobjDispCategory(boost::optional<string> const& vobjDispCategory)
    {
        m_vobjDispCategory = vobjDispCategory;
    }
    void doSetVobjDispSkipEmpty(bool vobjDispSkipEmpty) { m_vobjDispSkipEmpty = vobjDispSkipEmpty; }
    void doSetIsSetOnce(bool setOnce) { m_isSetOnce = setOnce; }
    void doSetIsVobjHidden(bool vobjHidden) { m_isVobjHidden = vobjHidden; }
    void doSetDefaultValue(boost::optional<ustring> const& defaultValue)
    {
        m_defaultValue = defaultValue;
    }
    void doSetIsQueryIndex(bool queryIndex) { m_isQueryIndex = queryIndex; }

private:
    bool m_isDerived = false;
    bool m_isComposite = false;
    bool m_isReadOnly = false;
    bool m_isUnique = false;
    Property m_qualifiedBy;
    bool m_customQualification = false;
    bool m_isQualificationUnique = true;
    Property m_opposite;
    int m_propertyIndex = 0;
    bool m_isPublicAccessor = true;
    bool m_isPublicMutator = true;
    bool m_isTransient = false;
    bool m_isSparse = false;
    StructuredType m_owningType;
    boost::optional<string> m_vobjDispCategory;
    bool m_vobjDispSkipEmpty = false;
    bool m_isSetOnce = false;
    bool m_isVobjHidden = false;
    boost::optional<ustring> m_defaultValue;
    bool m_isQueryIndex = false;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_isDerived, &BuilderImpl::m_isComposite, &BuilderImpl::m_isReadOnly,
        &BuilderImpl::m_isUnique, &BuilderImpl::m_qualifiedBy, &BuilderImpl::m_customQualification,
        &BuilderImpl::m_isQualificationUnique, &BuilderImpl::m_opposite,
        &BuilderImpl::m_propertyIndex, &BuilderImpl::m_isPublicAccessor,
        &BuilderImpl::m_isPublicMutator, &BuilderImpl::m_isTransient, &BuilderImpl::m_isSparse,
        &BuilderImpl::m_owningType, &BuilderImpl::m_vobjDispCategory,
        &BuilderImpl::m_vobjDispSkipEmpty, &BuilderImpl::m_isSetOnce, &BuilderImpl::m_isVobjHidden,
        &BuilderImpl::m_defaultValue, &BuilderImpl::m_isQueryIndex>;
};

/// The setters of what a `Property` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Property::Impl::BuilderBase : public TypedElement::Impl::BuilderBase<Final>
{
    using Above = TypedElement::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// Whether the value is computed and has no slot.
    Final& setIsDerived(bool derived)
    {
        return this->give(IS_DERIVED, &BuilderImpl::doSetIsDerived, derived);
    }

    /// Whether the value is contained in the element.
    Final& setIsComposite(bool composite)
    {
        return this->give(IS_COMPOSITE, &BuilderImpl::doSetIsComposite, composite);
    }

    /// Whether there is no setter.
    Final& setIsReadOnly(bool readOnly)
    {
        return this->give(IS_READ_ONLY, &BuilderImpl::doSetIsReadOnly, readOnly);
    }

    /// Whether a sequence refuses to hold a member twice.
    Final& setIsUnique(bool unique)
    {
        return this->give(IS_UNIQUE, &BuilderImpl::doSetIsUnique, unique);
    }

    /// The property of the members that is the key of this collection.
    Final& setQualifiedBy(Property const& qualifiedBy)
    {
        return this->give(QUALIFIED_BY, &BuilderImpl::doSetQualifiedBy, qualifiedBy);
    }

    /// Whether a client's code keeps the keys current.
    Final& setCustomQualification(bool customQualification)
    {
        return this->give(
            CUSTOM_QUALIFICATION, &BuilderImpl::doSetCustomQualification, customQualification);
    }

    /// Whether a key has one member at most.
    Final& setIsQualificationUnique(bool qualificationUnique)
    {
        return this->give(
            IS_QUALIFICATION_UNIQUE, &BuilderImpl::doSetIsQualificationUnique, qualificationUnique);
    }

    /// The other end of the association.
    Final& setOpposite(Property const& opposite)
    {
        return this->give(OPPOSITE, &BuilderImpl::doSetOpposite, opposite);
    }

    /// The slot, counted from 1; 0 if there is none.
    Final& setPropertyIndex(int propertyIndex)
    {
        return this->give(PROPERTY_INDEX, &BuilderImpl::doSetPropertyIndex, propertyIndex);
    }

    /// Whether any client may read it.
    Final& setIsPublicAccessor(bool publicAccessor)
    {
        return this->give(IS_PUBLIC_ACCESSOR, &BuilderImpl::doSetIsPublicAccessor, publicAccessor);
    }

    /// Whether any client may change it.
    Final& setIsPublicMutator(bool publicMutator)
    {
        return this->give(IS_PUBLIC_MUTATOR, &BuilderImpl::doSetIsPublicMutator, publicMutator);
    }

    /// Whether documents leave it out.
    Final& setIsTransient(bool transient)
    {
        return this->give(IS_TRANSIENT, &BuilderImpl::doSetIsTransient, transient);
    }

    /// Whether most elements have no value.
    Final& setIsSparse(bool sparse)
    {
        return this->give(IS_SPARSE, &BuilderImpl::doSetIsSparse, sparse);
    }

    /// The type that has it.
    Final& setOwningType(StructuredType const& owningType)
    {
        return this->give(OWNING_TYPE, &BuilderImpl::doSetOwningType, owningType);
    }

    /// The display group.
    Final& setVobjDispCategory(boost::optional<string> const& vobjDispCategory)
    {
        return this->give(
            VOBJ_DISP_CATEGORY, &BuilderImpl::doSetVobjDispCategory, vobjDispCategory);
    }
    Final& setVobjDispCategory(string const& vobjDispCategory)
    {
        return this->give(
            VOBJ_DISP_CATEGORY, &BuilderImpl::doSetVobjDispCategory, vobjDispCategory);
    }

    /// Whether displays leave out an empty value.
    Final& setVobjDispSkipEmpty(bool vobjDispSkipEmpty)
    {
        return this->give(
            VOBJ_DISP_SKIP_EMPTY, &BuilderImpl::doSetVobjDispSkipEmpty, vobjDispSkipEmpty);
    }

    /// Whether it may be set once, from the empty value.
    Final& setIsSetOnce(bool setOnce)
    {
        return this->give(IS_SET_ONCE, &BuilderImpl::doSetIsSetOnce, setOnce);
    }

    /// Whether displays leave it out.
    Final& setIsVobjHidden(bool vobjHidden)
    {
        return this->give(IS_VOBJ_HIDDEN, &BuilderImpl::doSetIsVobjHidden, vobjHidden);
    }

    /// The text of the value that new elements start with.
    Final& setDefaultValue(boost::optional<ustring> const& defaultValue)
    {
        return this->give(DEFAULT_VALUE, &BuilderImpl::doSetDefaultValue, defaultValue);
    }
    Final& setDefaultValue(ustring const& defaultValue)
    {
        return this->give(DEFAULT_VALUE, &BuilderImpl::doSetDefaultValue, defaultValue);
    }

    /// Whether queries ask for it often.
    Final& setIsQueryIndex(bool queryIndex)
    {
        return this->give(IS_QUERY_INDEX, &BuilderImpl::doSetIsQueryIndex, queryIndex);
    }
};

/// Describes a `Property` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Property::Builder final
    : public Property::Impl::BuilderBase<Property::Builder>
{
public:
    using Handle = Property;

    /// For a builder inside another one, whose model it takes.
    Builder();
    explicit Builder(Model const& model);
    ~Builder() override;

private:
    friend class support::BuilderTop<Builder>;

    Impl::BuilderImpl m_values{*this};
};
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Property::Impl, tarn::kiln::meta::TypedElement::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Property::Builder>;
