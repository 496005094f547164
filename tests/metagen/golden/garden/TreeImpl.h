// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What stands behind a `Tree`.
#pragma once
#include "acme/garden/PlantImpl.h"
#include "acme/garden/Tree.h"
#include "tarnkiln/support/Dispatch.h"

#include <boost/date_time/posix_time/ptime.hpp>

namespace acme::garden {

/// The properties of a `Tree`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class Tree::Impl : public support::Dispatched<Tree::Impl, Plant::Impl>
{
public:
    class BuilderImpl;                         // TreeBuilder.h
    template <class Final> class BuilderBase;  // TreeBuilder.h

    using Handle = Tree;
    using Storage = support::Record<Impl, Plant::Impl::Storage>;

    static constexpr unsigned long SLOTS = 10;
    static Slot const PLANTED;
    static Slot const GRAFT;
    static Slot const STOCK;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The planted.
    /// \throws tarnkiln::messages::CannotSetReadOnlyProperty  if it has a value already.
    boost::posix_time::ptime const& getPlanted() const { return m_planted; }
    void setPlanted(boost::posix_time::ptime const& planted);

    /// The graft.
    Tree getGraft() const;
    /// Null if there is none; a proxy stays one.
    Tree::Impl* getGraftImpl() const { return m_graft.get(); }
    /// Whether there is one and it is live.
    bool hasGraft() const;
    void setGraft(Tree const& graft);

    /// The stock.
    Tree getStock() const;
    /// Null if there is none; a proxy stays one.
    Tree::Impl* getStockImpl() const { return m_stock.get(); }
    /// Whether there is one and it is live.
    bool hasStock() const;
    void setStock(Tree const& stock);

    double yield() const override;

private:
    boost::posix_time::ptime m_planted;
    mutable support::CountedPointer<Tree::Impl> m_graft;
    mutable support::CountedPointer<Tree::Impl> m_stock;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_planted, PLANTED, &Impl::setPlanted>,
        support::Reference<Tree, &Impl::m_graft, GRAFT, &Impl::setGraft>,
        support::Reference<Tree, &Impl::m_stock, STOCK, &Impl::setStock>>;
};

inline Tree::Tree(Impl* impl) : Plant(impl) {}
inline Tree::Impl* Tree::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Tree::Impl* Tree::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace acme::garden

extern template class tarn::kiln::support::Record<
    acme::garden::Tree::Impl, acme::garden::Plant::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    acme::garden::Tree::Impl, acme::garden::Plant::Impl>;
