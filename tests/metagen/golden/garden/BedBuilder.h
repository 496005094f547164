// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What describes a new `Bed` and makes it.
#pragma once
#include "acme/garden/BedImpl.h"
#include "tarnkiln/support/Builder.h"

#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

namespace acme::garden {

/// The values of a `Bed` to be.
class Bed::Impl::BuilderImpl : public support::BuilderValues<Bed::Impl, support::BuilderRoot>
{
public:
    using BuilderValues::BuilderValues;

    void doAddPlants(std::unique_ptr<ModelElement::Builder> plants)
    {
        support::addNested(m_plants, std::move(plants));
    }
    void doClearPlants() { m_plants.clear(); }
    void doSetSize(Size const& size) { m_size = size; }
    void doAddNeighbours(Bed const& neighbours) { m_neighbours.push_back(neighbours); }
    void doClearNeighbours() { m_neighbours.clear(); }

private:
    support::NestedBuilders m_plants;
    Size m_size;
    std::vector<Bed> m_neighbours;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_plants, &BuilderImpl::m_size, &BuilderImpl::m_neighbours>;
};

/// The setters of what a `Bed` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Bed::Impl::BuilderBase : public support::BuilderTop<Final>
{
    using Above = support::BuilderTop<Final>;

public:
    using Above::Above;

    /// What grows here, by name.
    Final& addPlants(std::unique_ptr<ModelElement::Builder> plants)
    {
        return this->give(PLANTS, &BuilderImpl::doAddPlants, std::move(plants));
    }
    Final& clearPlants() { return this->give(PLANTS, &BuilderImpl::doClearPlants); }

    /// The size.
    Final& setSize(Size const& size) { return this->give(SIZE, &BuilderImpl::doSetSize, size); }

    /// The neighbours.
    Final& addNeighbours(Bed const& neighbours)
    {
        return this->give(NEIGHBOURS, &BuilderImpl::doAddNeighbours, neighbours);
    }
    Final& addNeighbours(std::initializer_list<Bed> neighbours)
    {
        return this->giveEach(NEIGHBOURS, &BuilderImpl::doAddNeighbours, neighbours);
    }
    Final& clearNeighbours() { return this->give(NEIGHBOURS, &BuilderImpl::doClearNeighbours); }
};

/// Describes a `Bed` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class Bed::Builder final : public Bed::Impl::BuilderBase<Bed::Builder>
{
public:
    using Handle = Bed;

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
    acme::garden::Bed::Impl, tarn::kiln::support::BuilderRoot>;
extern template class tarn::kiln::support::BuilderTop<acme::garden::Bed::Builder>;
