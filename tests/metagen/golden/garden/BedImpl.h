// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What stands behind a `Bed`.
#pragma once
#include "acme/garden/Bed.h"
#include "acme/garden/Plant.h"
#include "acme/garden/Size.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/UnorderedElementSet.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>
#include <vector>

namespace acme::garden {

/// The properties of a `Bed`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class Bed::Impl : public support::Dispatched<Bed::Impl, ModelElement::Impl>
{
public:
    class BuilderImpl;                         // BedBuilder.h
    template <class Final> class BuilderBase;  // BedBuilder.h

    using Handle = Bed;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 4;
    static Slot const PLANTS;
    static Slot const SIZE;
    static Slot const NEIGHBOURS;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// What grows here, by name.
    ElementMap<ustring, Plant>& getPlants() const;
    /// Whether the collection was made, as its getter does.
    bool hasPlants() const { return m_plants.get(); }

    /// The size.
    Size const& getSize() const { return m_size; }
    void setSize(Size const& size);

    /// The neighbours.
    UnorderedElementSet<Bed>& getNeighbours() const;
    /// Whether the collection was made, as its getter does.
    bool hasNeighbours() const { return m_neighbours.get(); }

    /// The area.
    double getArea() const;

    /// Gives all plants their share.
    void water(int litres);

    /// Somebody dug the bed over.
    ///
    /// An event: it waits, as a `BedDugEvent`, for the end of the open transaction, and is dropped
    /// by a rollback. Where no transaction is open it happens at once.
    void dug(int depth, Plant const& moved, std::vector<ustring> const& tools, Season season);

    /// What happens when `dug` has waited.
    void doDug(int depth, Plant const& moved, std::vector<ustring> const& tools, Season season);

private:
    static std::unique_ptr<ElementMap<ustring, Plant>> makePlants(Impl* owner);
    static std::unique_ptr<UnorderedElementSet<Bed>> makeNeighbours(Impl* owner);

    mutable support::LazyCollection<ElementMap<ustring, Plant>> m_plants;
    Size m_size;
    mutable support::LazyCollection<UnorderedElementSet<Bed>> m_neighbours;

public:
    using Rows = support::RowList<
        support::References<&Impl::m_plants, PLANTS, &Impl::makePlants, &Impl::getPlants>,
        support::Scalar<&Impl::m_size, SIZE, &Impl::setSize>,
        support::References<
            &Impl::m_neighbours, NEIGHBOURS, &Impl::makeNeighbours, &Impl::getNeighbours>>;
};

inline Bed::Bed(Impl* impl) : ModelElement(impl) {}
inline Bed::Impl* Bed::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Bed::Impl* Bed::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace acme::garden

extern template class tarn::kiln::support::Record<
    acme::garden::Bed::Impl, tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    acme::garden::Bed::Impl, tarn::kiln::ModelElement::Impl>;
