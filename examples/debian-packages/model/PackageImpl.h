/// \file
/// What stands behind a `Package`.
#pragma once
#include "model/Package.h"
#include "model/PackageIndex.h"
#include "model/Release.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/support/Dispatch.h"
#include "tarnkiln/support/LazyCollection.h"

#include <memory>

namespace debian::model {

/// The properties of a `Package`, written the way generated classes are.
///
/// Setters work in the open transaction of the model, or in one of their own.
class Package::Impl : public support::Dispatched<Package::Impl, ModelElement::Impl>
{
public:
    using Handle = Package;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 5;
    static Slot const NAME;
    static Slot const INDEX;
    static Slot const RELEASES;
    static Slot const PROVIDERS;

    Impl(Model const& model, UUID const& id);
    ~Impl() override;

    /// The key in the index.
    ustring const& getName() const { return m_name; }
    void setName(ustring const& name);

    /// The owner.
    PackageIndex getIndex() const;
    PackageIndex::Impl* getIndexImpl() const;
    void setIndex(PackageIndex const& index);

    /// What the index holds of it, by version and architecture.
    ElementMap<ustring, Release>& getReleases() const;
    bool hasReleases() const { return m_releases.get(); }  ///< Whether the collection was made.

    /// The releases of other packages that can stand in for it.
    ElementSequence<Release>& getProviders() const;
    bool hasProviders() const { return m_providers.get(); }  ///< Whether the collection was made.

private:
    static std::unique_ptr<ElementMap<ustring, Release>> makeReleases(Impl* owner);
    static std::unique_ptr<ElementSequence<Release>> makeProviders(Impl* owner);

    ustring m_name;
    mutable support::LazyCollection<ElementMap<ustring, Release>> m_releases;
    mutable support::LazyCollection<ElementSequence<Release>> m_providers;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_name, NAME, &Impl::setName>,
        support::Container<PackageIndex, INDEX, &Impl::setIndex>,
        support::References<&Impl::m_releases, RELEASES, &Impl::makeReleases, &Impl::getReleases>,
        support::References<&Impl::m_providers, PROVIDERS, &Impl::makeProviders,
                            &Impl::getProviders>>;
};

inline Package::Package(Impl* impl) : ModelElement(impl) {}
inline Package::Impl* Package::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Package::Impl* Package::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace debian::model

extern template class tarn::kiln::support::Record<debian::model::Package::Impl,
                                                  tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<debian::model::Package::Impl,
                                                      tarn::kiln::ModelElement::Impl>;
