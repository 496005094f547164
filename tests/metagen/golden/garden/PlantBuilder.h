// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What describes a new `Plant` and makes it.
#pragma once
#include "acme/garden/PlantImpl.h"
#include "tarnkiln/support/Builder.h"

#include <initializer_list>
#include <vector>

namespace acme::garden {

/// The values of a `Plant` to be.
class Plant::Impl::BuilderImpl : public support::BuilderValues<Plant::Impl, support::BuilderRoot>
{
public:
    using BuilderValues::BuilderValues;

    void doSetName(ustring const& name) { m_name = name; }
    void doSetBed(Bed const& bed) { m_bed = bed; }
    void doSetSown(Season sown) { m_sown = sown; }
    void doSetHeight(boost::optional<int> const& height) { m_height = height; }
    void doSetIsHardy(bool hardy) { m_isHardy = hardy; }
    void doAddNotes(ustring const& notes) { m_notes.push_back(notes); }
    void doClearNotes() { m_notes.clear(); }

private:
    ustring m_name;
    Bed m_bed;
    Season m_sown = Season::Autumn;
    boost::optional<int> m_height;
    bool m_isHardy = true;
    std::vector<ustring> m_notes;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_name, &BuilderImpl::m_bed, &BuilderImpl::m_sown, &BuilderImpl::m_height,
        &BuilderImpl::m_isHardy, &BuilderImpl::m_notes>;
};

/// The setters of what a `Plant` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Plant::Impl::BuilderBase : public support::BuilderTop<Final>
{
    using Above = support::BuilderTop<Final>;

public:
    using Above::Above;

    /// What the bed knows it by.
    Final& setName(ustring const& name) { return this->give(NAME, &BuilderImpl::doSetName, name); }

    /// The bed.
    Final& setBed(Bed const& bed) { return this->give(BED, &BuilderImpl::doSetBed, bed); }

    /// The sown.
    Final& setSown(Season sown) { return this->give(SOWN, &BuilderImpl::doSetSown, sown); }

    /// In centimetres.
    Final& setHeight(boost::optional<int> const& height)
    {
        return this->give(HEIGHT, &BuilderImpl::doSetHeight, height);
    }
    Final& setHeight(int height) { return this->give(HEIGHT, &BuilderImpl::doSetHeight, height); }

    /// The is hardy.
    Final& setIsHardy(bool hardy)
    {
        return this->give(IS_HARDY, &BuilderImpl::doSetIsHardy, hardy);
    }

    /// The notes.
    Final& addNotes(ustring const& notes)
    {
        return this->give(NOTES, &BuilderImpl::doAddNotes, notes);
    }
    Final& addNotes(std::initializer_list<ustring> notes)
    {
        return this->giveEach(NOTES, &BuilderImpl::doAddNotes, notes);
    }
    Final& clearNotes() { return this->give(NOTES, &BuilderImpl::doClearNotes); }
};

/// Describes a `Plant` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class Plant::Builder final : public Plant::Impl::BuilderBase<Plant::Builder>
{
public:
    using Handle = Plant;

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
    acme::garden::Plant::Impl, tarn::kiln::support::BuilderRoot>;
extern template class tarn::kiln::support::BuilderTop<acme::garden::Plant::Builder>;
