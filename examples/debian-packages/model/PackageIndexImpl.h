/// \file
/// What stands behind a `PackageIndex`.
#pragma once
#include "model/Package.h"
#include "model/PackageIndex.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/support/Dispatch.h"
#include "tarnkiln/support/LazyCollection.h"

#include <memory>

namespace debian::model {

/// The properties of a `PackageIndex`, written the way generated classes are.
///
/// Setters work in the open transaction of the model, or in one of their own.
class PackageIndex::Impl : public support::Dispatched<PackageIndex::Impl, ModelElement::Impl>
{
public:
    using Handle = PackageIndex;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 2;
    static Slot const PACKAGES;

    Impl(Model const& model, UUID const& id);
    ~Impl() override;

    /// The packages, by name.
    ElementMap<ustring, Package>& getPackages() const;
    bool hasPackages() const { return m_packages.get(); }  ///< Whether the collection was made.

private:
    static std::unique_ptr<ElementMap<ustring, Package>> makePackages(Impl* owner);

    mutable support::LazyCollection<ElementMap<ustring, Package>> m_packages;

public:
    using Rows = support::RowList<
        support::References<&Impl::m_packages, PACKAGES, &Impl::makePackages, &Impl::getPackages>>;
};

inline PackageIndex::PackageIndex(Impl* impl) : ModelElement(impl) {}
inline PackageIndex::Impl* PackageIndex::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline PackageIndex::Impl* PackageIndex::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace debian::model

extern template class tarn::kiln::support::Record<debian::model::PackageIndex::Impl,
                                                  tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<debian::model::PackageIndex::Impl,
                                                      tarn::kiln::ModelElement::Impl>;
