// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What describes a new `Tree` and makes it.
#pragma once
#include "acme/garden/PlantBuilder.h"
#include "acme/garden/TreeImpl.h"

namespace acme::garden {

/// The values of a `Tree` to be.
class Tree::Impl::BuilderImpl : public support::BuilderValues<Tree::Impl, Plant::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetPlanted(boost::posix_time::ptime const& planted) { m_planted = planted; }
    void doSetGraft(Tree const& graft) { m_graft = graft; }
    void doSetStock(Tree const& stock) { m_stock = stock; }

private:
    boost::posix_time::ptime m_planted;
    Tree m_graft;
    Tree m_stock;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_planted, &BuilderImpl::m_graft, &BuilderImpl::m_stock>;
};

/// The setters of what a `Tree` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Tree::Impl::BuilderBase : public Plant::Impl::BuilderBase<Final>
{
    using Above = Plant::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The planted.
    Final& setPlanted(boost::posix_time::ptime const& planted)
    {
        return this->give(PLANTED, &BuilderImpl::doSetPlanted, planted);
    }

    /// The graft.
    Final& setGraft(Tree const& graft)
    {
        return this->give(GRAFT, &BuilderImpl::doSetGraft, graft);
    }

    /// The stock.
    Final& setStock(Tree const& stock)
    {
        return this->give(STOCK, &BuilderImpl::doSetStock, stock);
    }
};

/// Describes a `Tree` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class Tree::Builder final : public Tree::Impl::BuilderBase<Tree::Builder>
{
public:
    using Handle = Tree;

    /// For a builder inside another one, whose model it takes.
    Builder();
    explicit Builder(Model const& model);
    ~Builder() override;

private:
    friend class support::BuilderTop<Builder>;

    Impl::BuilderImpl m_values{*this};
};
}  // namespace acme::garden

extern template class tarn::kiln::support::BuilderValues<
    acme::garden::Tree::Impl, acme::garden::Plant::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<acme::garden::Tree::Builder>;
