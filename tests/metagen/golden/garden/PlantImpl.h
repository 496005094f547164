// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What stands behind a `Plant`.
#pragma once
#include "acme/garden/Bed.h"
#include "acme/garden/Plant.h"
#include "acme/garden/Season.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/support/Dispatch.h"

#include <boost/optional.hpp>

#include <memory>

namespace acme::garden {

/// The properties of a `Plant`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class Plant::Impl : public support::Dispatched<Plant::Impl, ModelElement::Impl>
{
public:
    class BuilderImpl;                         // PlantBuilder.h
    template <class Final> class BuilderBase;  // PlantBuilder.h

    using Handle = Plant;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 7;
    static Slot const NAME;
    static Slot const BED;
    static Slot const SOWN;
    static Slot const HEIGHT;
    static Slot const IS_HARDY;
    static Slot const NOTES;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// What the bed knows it by.
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such name.
    ustring const& getName() const { return m_name; }
    void setName(ustring const& name);

    /// The bed.
    Bed getBed() const;
    Bed::Impl* getBedImpl() const;
    /// Whether there is one and it is live.
    bool hasBed() const;
    void setBed(Bed const& bed);

    /// The sown.
    Season getSown() const { return m_sown; }
    void setSown(Season sown);

    /// In centimetres.
    boost::optional<int> const& getHeight() const { return m_height; }
    void setHeight(boost::optional<int> const& height);

    /// Whether it is hardy.
    bool isHardy() const { return m_isHardy; }
    void setIsHardy(bool hardy);

    /// The notes.
    PrimitiveSequence<ustring>& getNotes() const;
    /// Whether the collection was made, as its getter does.
    bool hasNotes() const { return m_notes.get(); }

    /// Kilograms in a year.
    virtual double yield() const = 0;

private:
    static std::unique_ptr<PrimitiveSequence<ustring>> makeNotes(Impl* owner);

    ustring m_name;
    Season m_sown = Season::Autumn;
    boost::optional<int> m_height;
    bool m_isHardy = true;
    mutable support::LazyCollection<PrimitiveSequence<ustring>> m_notes;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_name, NAME, &Impl::setName>,
        support::Container<Bed, BED, &Impl::setBed>,
        support::Scalar<&Impl::m_sown, SOWN, &Impl::setSown>,
        support::Optional<&Impl::m_height, HEIGHT, &Impl::setHeight>,
        support::Scalar<&Impl::m_isHardy, IS_HARDY, &Impl::setIsHardy>,
        support::Values<&Impl::m_notes, NOTES, &Impl::makeNotes, &Impl::getNotes>>;
};

inline Plant::Plant(Impl* impl) : ModelElement(impl) {}
inline Plant::Impl* Plant::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Plant::Impl* Plant::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace acme::garden

extern template class tarn::kiln::support::Record<
    acme::garden::Plant::Impl, tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    acme::garden::Plant::Impl, tarn::kiln::ModelElement::Impl>;
