/// \file
/// What stands behind a `DependencyGroup`.
#pragma once
#include "model/Alternative.h"
#include "model/DependencyGroup.h"
#include "model/Release.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/support/Dispatch.h"
#include "tarnkiln/support/LazyCollection.h"

#include <memory>

namespace debian::model {

/// The properties of a `DependencyGroup`, written the way generated classes are.
///
/// Setters work in the open transaction of the model, or in one of their own.
class DependencyGroup::Impl : public support::Dispatched<DependencyGroup::Impl, ModelElement::Impl>
{
public:
    using Handle = DependencyGroup;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 4;
    static Slot const KIND;
    static Slot const RELEASE;
    static Slot const ALTERNATIVES;

    Impl(Model const& model, UUID const& id);
    ~Impl() override;

    /// The field that it comes from, such as "Depends".
    ustring const& getKind() const { return m_kind; }
    void setKind(ustring const& kind);

    /// The owner.
    Release getRelease() const;
    Release::Impl* getReleaseImpl() const;
    void setRelease(Release const& release);

    /// In the order of preference.
    ElementSequence<Alternative>& getAlternatives() const;
    bool hasAlternatives() const
    {
        return m_alternatives.get();
    }  ///< Whether the collection was made.

private:
    static std::unique_ptr<ElementSequence<Alternative>> makeAlternatives(Impl* owner);

    ustring m_kind;
    mutable support::LazyCollection<ElementSequence<Alternative>> m_alternatives;

public:
    using Rows =
        support::RowList<support::Scalar<&Impl::m_kind, KIND, &Impl::setKind>,
                         support::Container<Release, RELEASE, &Impl::setRelease>,
                         support::References<&Impl::m_alternatives, ALTERNATIVES,
                                             &Impl::makeAlternatives, &Impl::getAlternatives>>;
};

inline DependencyGroup::DependencyGroup(Impl* impl) : ModelElement(impl) {}
inline DependencyGroup::Impl* DependencyGroup::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline DependencyGroup::Impl* DependencyGroup::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace debian::model

extern template class tarn::kiln::support::Record<debian::model::DependencyGroup::Impl,
                                                  tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<debian::model::DependencyGroup::Impl,
                                                      tarn::kiln::ModelElement::Impl>;
