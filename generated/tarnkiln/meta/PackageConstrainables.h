// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `Package`.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/NamedElementConstrainables.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `Package`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Package::Constrainables : public NamedElement::Constrainables
{
public:
    using Handle = Package;

    /// Adds an instance to a query: `Package::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The types, by name.
    query::ConstrainableReference<Type> ownedTypes;

    /// The packages inside, by name.
    query::ConstrainableReference<Package> nestedPackages;

    /// The names from the root package on, separated by dots.
    query::ConstrainableValue<ustring, true> qualifiedName;

    /// What the package is known by among metamodels.
    query::ConstrainableValue<ustring, true> uri;

    /// The package around it.
    query::ConstrainableReference<Package> parentPackage;

    /// The root packages whose types this one uses.
    query::ConstrainableValue<ustring> importedPackageURIs;

    /// The display group of properties without one.
    query::ConstrainableValue<string> defaultVobjCategory;

    /// The enumerations among the types, by name; a view, which can only be read.
    query::ConstrainableReference<Enum> enumerations;

    /// The classes among the types, by name; a view, which can only be read.
    query::ConstrainableReference<Class> classes;

    /// The data types among the types, by name; a view, which can only be read.
    query::ConstrainableReference<DataType> dataTypes;

    /// The primitive types among the types, by name; a view, which can only be read.
    query::ConstrainableReference<PrimitiveType> primitiveTypes;
};
}  // namespace tarn::kiln::meta
