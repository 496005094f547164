/// \file
/// A metamodel defined at run time, in a few lines.
///
///     PackageDefinition library(u"library", u"http://example.org/library");
///     ClassDefinition book = library.defineClass(u"Book");
///     book.attribute(u"title", StandardTypes::stringMeta);
///     ClassDefinition shelf = library.defineClass(u"Shelf");
///     shelf.contents(u"books", book).sequence().opposite(u"shelf");
///     library.finish();
///     ModelElement const emma = ModelElement::createReflective(model, book, UUID());
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/ClassDefinition.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/Package.h"

#include <initializer_list>
#include <optional>
#include <vector>

namespace tarn::kiln::meta {

/// Defines a root package with its types in the registry's model, in one transaction.
///
/// Nothing of it stays unless `finish` is called and returns.
///
/// Threads: holds the registry's lock until it is finished, and must live on one thread. Keep it
/// short: other threads that define metamodels wait.
class TARNKILN_EXPORT PackageDefinition
{
public:
    /// \param uri  what the package is known by; an earlier package of that URI stays a package,
    ///     but is not found by it any more.
    PackageDefinition(ustring const& name, ustring const& uri);
    PackageDefinition(PackageDefinition const&) = delete;
    PackageDefinition& operator=(PackageDefinition const&) = delete;
    ~PackageDefinition();

    /// A new class without properties. Fails with `UniquenessConstraint` if the name is taken.
    ClassDefinition defineClass(ustring const& name);
    /// A new enumeration whose literals are numbered from 0, in the order given. Fails with
    /// `UniquenessConstraint` if its name is taken or a literal is named twice.
    Enum defineEnum(ustring const& name, std::initializer_list<ustring> literals);

    /// Numbers the slots of all classes, each after those of its superclass, commits, and makes
    /// the package known to the registry, with builders of reflective elements; the registry is
    /// then frozen again. Must be called once at most.
    ///
    /// \throws tarnkiln::messages::DuplicateTypeInRegistry  (qualified name) if another package
    ///     has a type of that qualified name.
    /// \throws std::runtime_error  if a listener of the registry's model refuses.
    Package finish();

private:
    void numberSlots(Class const& defined);

    MetaRegistry& m_registry;
    std::optional<MetaRegistry::LockedModel> m_locked;  ///< Until the package is finished.
    Transaction m_transaction;
    Package m_package;
    std::vector<Class> m_classes;
    std::vector<Enum> m_enums;
};
}  // namespace tarn::kiln::meta
