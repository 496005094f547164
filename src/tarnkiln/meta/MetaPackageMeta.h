/// \file
/// The metamodel of metamodels, which describes all metamodels and itself.
///
///     meta::MetaPackageMeta& catalogue = meta::MetaPackageMeta::getInstance();
///     meta::Property name = catalogue.getProperty(meta::rows::properties::NamedElementName);
#pragma once
#include "tarnkiln/meta/CatalogueRows.h"
#include "tarnkiln/support/RowPackage.h"

namespace tarn::kiln::meta {

/// Builds the catalogue in the registry at its first use and holds the handles of its elements.
///
/// `C::metaClass()` of all classes in this folder answers from here. What the catalogue contains
/// stands in `catalogue.json`, from which `CatalogueRows.cpp` is made.
///
/// Threads: any; see `support::RowPackage`.
class TARNKILN_EXPORT MetaPackageMeta final : public support::RowPackage
{
public:
    /// The catalogue, complete except on the thread that is just building it.
    static MetaPackageMeta& getInstance();

    /// The classes `Model` and `ModelElement`, which the registry makes by itself.
    Class const& getModelClass() const;
    Class const& getModelElementClass() const;

private:
    MetaPackageMeta();

    void completed() override;
};

/// The function that gives the property of a row, for the `Slot` of a generated class.
template <rows::properties::Row ROW>
inline constexpr auto propertyOf = &support::propertyAt<MetaPackageMeta, ROW>;
}  // namespace tarn::kiln::meta
