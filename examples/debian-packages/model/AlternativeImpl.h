/// \file
/// What stands behind a `Alternative`.
#pragma once
#include "model/Alternative.h"
#include "model/DependencyGroup.h"
#include "model/Package.h"
#include "tarnkiln/support/CountedPointer.h"
#include "tarnkiln/support/Dispatch.h"

namespace debian::model {

/// The properties of a `Alternative`, written the way generated classes are.
///
/// Setters work in the open transaction of the model, or in one of their own.
class Alternative::Impl : public support::Dispatched<Alternative::Impl, ModelElement::Impl>
{
public:
    using Handle = Alternative;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 5;
    static Slot const GROUP;
    static Slot const RELATION;
    static Slot const BOUND;
    static Slot const TARGET;

    Impl(Model const& model, UUID const& id);
    ~Impl() override;

    /// The owner.
    DependencyGroup getGroup() const;
    DependencyGroup::Impl* getGroupImpl() const;
    void setGroup(DependencyGroup const& group);

    /// Such as ">="; empty if any version will do.
    ustring const& getRelation() const { return m_relation; }
    void setRelation(ustring const& relation);

    /// The version that the relation compares with.
    ustring const& getBound() const { return m_bound; }
    void setBound(ustring const& bound);

    /// The package; has no opposite, so that it may lie in another model.
    Package getTarget() const;
    /// Null if there is none; a proxy stays one.
    Package::Impl* getTargetImpl() const;
    void setTarget(Package const& target);

private:
    ustring m_relation;
    ustring m_bound;
    mutable support::CountedPointer<Package::Impl> m_target;

public:
    using Rows =
        support::RowList<support::Container<DependencyGroup, GROUP, &Impl::setGroup>,
                         support::Scalar<&Impl::m_relation, RELATION, &Impl::setRelation>,
                         support::Scalar<&Impl::m_bound, BOUND, &Impl::setBound>,
                         support::Reference<Package, &Impl::m_target, TARGET, &Impl::setTarget>>;
};

inline Alternative::Alternative(Impl* impl) : ModelElement(impl) {}
inline Alternative::Impl* Alternative::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Alternative::Impl* Alternative::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace debian::model

extern template class tarn::kiln::support::Record<debian::model::Alternative::Impl,
                                                  tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<debian::model::Alternative::Impl,
                                                      tarn::kiln::ModelElement::Impl>;
