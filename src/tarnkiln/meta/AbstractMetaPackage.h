/// \file
/// The base class of meta packages: how a metamodel gets into the registry.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/ValueFlags.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/MetaRegistry.h"

#include <initializer_list>
#include <memory>

namespace tarn::kiln::meta {

/// Creates the elements of a metamodel in the registry's model.
///
/// Each function that creates something locks the registry, and works in the open transaction of
/// its model or in one of its own. A metamodel that is to appear as a whole holds one `LockedModel`
/// and one transaction around all calls: otherwise another thread's elements may come between, and
/// end up in its transaction.
///
/// A UUID is given as text; one that is none raises `boost::bad_lexical_cast`.
///
/// Threads: any.
class TARNKILN_EXPORT AbstractMetaPackage
{
public:
    AbstractMetaPackage(AbstractMetaPackage const&) = delete;
    AbstractMetaPackage& operator=(AbstractMetaPackage const&) = delete;
    virtual ~AbstractMetaPackage();

    /// \name Elements, without an owner and without references
    /// @{
    /// A package with a fresh UUID.
    Package createPackage(ustring const& name, ustring const& uri) const;
    Class createClass(ustring const& name, string const& vobjName, bool isAbstract,
                      string const& uuid) const;
    DataType createDataType(ustring const& name, string const& vobjName, string const& uuid) const;
    /// `Single` makes a required single value, `OptionalSingle` an optional one, `Sequence` an
    /// ordered and everything else an unordered property without an upper bound.
    Property createProperty(ustring const& name, ValueFlags flags, bool isComposite,
                            string const& uuid) const;
    Enum createEnum(ustring const& name, string const& uuid) const;
    EnumLiteral createEnumLiteral(ustring const& name, int value, string const& uuid) const;
    /// @}

    void setPropertyIndex(Property const& property, int index) const;
    /// Gives the operation what calls by reflection run, in place of what it had, which is
    /// destroyed.
    void setInvoker(Operation const& operation, std::unique_ptr<AbstractMethodInvoker> invoker);

    /// \name The registry; the caller of the first two holds a `LockedModel`
    /// @{
    void registerRootPackage(Package const& package) const;
    void unregisterRootPackage(ustring const& uri) const;
    /// Replaces what makes collections of `type`, which must be registered.
    void updateCollectionInstantiator(Type const& type,
                                      MetaRegistry::CollectionInstantiator collection) const;
    /// @}

    /// \name How displays of the scripting layer show a type
    /// @{
    void setVobjClassName(StructuredType const& type, char const* name) const;
    void setVobjCompactDisplay(StructuredType const& type, bool compact) const;
    void setVobjDispCategory(Property const& property, string const& category) const;
    /// Makes displays leave out an empty value.
    void setVobjDispSkipEmpty(Property const& property) const;
    void setDefaultVobjCategory(Package const& package, string const& category) const;
    /// Replaces the categories of `type`, in one change.
    void setOrderedVobjDispCategories(StructuredType const& type,
                                      std::initializer_list<string> categories) const;
    /// @}

protected:
    AbstractMetaPackage();
};
}  // namespace tarn::kiln::meta
