// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Argument` and makes it.
#pragma once
#include "tarnkiln/meta/ArgumentImpl.h"
#include "tarnkiln/meta/TypedElementBuilder.h"

namespace tarn::kiln::meta {

/// The values of an `Argument` to be.
class TARNKILN_EXPORT Argument::Impl::BuilderImpl
    : public support::BuilderValues<Argument::Impl, TypedElement::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetOperation(Operation const& value) { m_operation = value; }
    void doSetIsInput(bool input) { m_isInput = input; }

private:
    Operation m_operation;
    bool m_isInput = true;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_operation, &BuilderImpl::m_isInput>;
};

/// The setters of what an `Argument` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Argument::Impl::BuilderBase : public TypedElement::Impl::BuilderBase<Final>
{
    using Above = TypedElement::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The operation whose argument this is.
    Final& setOperation(Operation const& value)
    {
        return this->give(OPERATION, &BuilderImpl::doSetOperation, value);
    }

    /// Whether the caller supplies it.
    Final& setIsInput(bool input)
    {
        return this->give(IS_INPUT, &BuilderImpl::doSetIsInput, input);
    }
};

/// Describes an `Argument` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Argument::Builder final
    : public Argument::Impl::BuilderBase<Argument::Builder>
{
public:
    using Handle = Argument;

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
    tarn::kiln::meta::Argument::Impl, tarn::kiln::meta::TypedElement::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Argument::Builder>;
