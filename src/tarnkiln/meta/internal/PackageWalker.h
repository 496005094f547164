/// \file
/// How the rows of a metamodel become elements.
#pragma once
#include "tarnkiln/support/PackageElements.h"
#include "tarnkiln/support/PackageRows.h"

namespace tarn::kiln::meta {
class AbstractMetaPackage;
}

namespace tarn::kiln::internal {

/// Creates, connects and registers the elements of a metamodel, in two passes over its rows.
///
/// No row is connected before all are created, so that they may refer to each other in any order,
/// and each type is registered when all of its own rows are connected.
///
/// Threads: under a `LockedModel` of the registry and in a transaction of its model.
class PackageWalker
{
public:
    PackageWalker(meta::AbstractMetaPackage& package, support::PackageRows const& rows,
                  support::PackageElements& elements);

    /// \throws tarnkiln::messages::NoSuchType  (name) if a required type is not registered.
    /// \throws boost::bad_lexical_cast  if the UUID of a row is none.
    void createElements();
    /// \throws tarnkiln::messages::NoSuchType  (name) if a type that a row names is not registered.
    /// \throws tarnkiln::messages::DuplicateTypeInRegistry  (name) if a type of that name is.
    void connectAndRegister();

private:
    void createPackages();
    void createPrimitiveTypes(std::size_t package);
    void setDisplay(support::StructuredTypeRow const& row, meta::StructuredType const& type);
    void createMembers(support::StructuredTypeRow const& row);
    void createProperty(std::size_t number);
    void createOperation(std::size_t number);
    void createEnum(std::size_t number);

    void connectPrimitiveType(std::size_t number);
    void connectMembers(support::StructuredTypeRow const& row, meta::StructuredType const& owner);
    void connectProperty(std::size_t number, meta::StructuredType const& owner);
    void connectOperation(std::size_t number, meta::StructuredType const& owner);
    void connectEnum(std::size_t number);

    meta::Type typeOf(support::TypeReference const& reference) const;
    meta::Property propertyOf(support::PropertyReference const& reference) const;

    meta::AbstractMetaPackage& m_package;
    support::PackageRows const& m_rows;
    support::PackageElements& m_elements;
};
}  // namespace tarn::kiln::internal
