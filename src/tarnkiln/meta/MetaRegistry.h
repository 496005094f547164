/// \file
/// The process-wide directory of all metamodels.
///
///     meta::MetaRegistry& registry = meta::MetaRegistry::getInstance();
///     meta::Class book = registry.getClass(u"library.Book");
///
///     {
///         meta::MetaRegistry::LockedModel locked(registry); // changes need it, look-ups do not
///         Transaction transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
///         ...
///         transaction.commit();
///     }
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/collections/Fwd.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/meta/ValueOwnershipConverter.h"

#include <atomic>
#include <memory>
#include <mutex>
#include <unordered_map>
#include <utility>
#include <vector>

namespace tarn::kiln::internal {
class UnregisterDestroyedTypes;
template <class Table> class Published;
}  // namespace tarn::kiln::internal

namespace tarn::kiln::meta {

/// Owns the model in which every metamodel lives, and finds types by name, packages by URI and the
/// current version of a family of packages.
///
/// The registry model is frozen except while a `LockedModel` lives; its elements may therefore be
/// read on any thread without a lock.
///
/// Look-ups take no lock either. While one thread holds a `LockedModel`, the others find what was
/// there before it; what they do not find they wait for.
///
/// Threads: may be used from all threads. Functions that say "the caller holds a `LockedModel`"
/// take no lock of their own.
class TARNKILN_EXPORT MetaRegistry
{
public:
    class LockedModel;
    class LockedConstModel;

    /// Makes the collection that `owner` keeps as its value of `property`; the caller owns it. An
    /// empty owner asks for a snapshot.
    using CollectionInstantiator = AbstractOwnedCollection* (*)(ModelElement const& owner,
                                                                Property const& property);
    /// Makes a builder of elements of a class, in `model`.
    using BuilderInstantiator = std::unique_ptr<ModelElement::Builder> (*)(Model const& model);

    /// The URI of the registry model: "registry@registry://metaRegistry/model".
    static ustring const MetaRegistryModelID;

    MetaRegistry(MetaRegistry const&) = delete;
    MetaRegistry& operator=(MetaRegistry const&) = delete;

    /// The one registry, made at the first call, by whichever thread comes first. It lives to the
    /// end of the process.
    static MetaRegistry& getInstance();
    /// Whether the registry is complete; false also for the thread that is making it. Makes none.
    static bool isStarted();

    /// The model in which all metamodels live.
    Model const& getModel() const { return m_model; }

    /// \name Types
    /// @{
    /// Enters a type under `name`; either function may be null.
    ///
    /// An entry whose type is dead gives way to the new one. Makes the collections of the type's
    /// attributes, operations or literals, so that other threads need not. When the outermost
    /// `LockedModel` is left, the type and these become permanent, so that threads which share them
    /// write nothing to them.
    /// \throws tarnkiln::messages::DuplicateTypeInRegistry  (name) if another type has the name.
    void registerType(Type const& type, ustring const& name, CollectionInstantiator collection,
                      BuilderInstantiator builder);
    /// The same under the type's qualified name.
    void registerType(Type const& type, CollectionInstantiator collection,
                      BuilderInstantiator builder);
    void registerType(Type const& type, BuilderInstantiator builder);
    /// Enters a class that has no generated code, under its qualified name. Its builders make
    /// reflective elements.
    ///
    /// \throws tarnkiln::messages::DuplicateTypeInRegistry  (name) as above.
    void registerReflectiveClass(Class const& metaClass);
    /// Takes the entry out if it is that of `type`. The caller holds a `LockedModel`.
    void unregisterType(Type const& type, ustring const& name);
    /// Replaces what makes collections for `type`, which must be registered under its qualified
    /// name.
    void updateCollectionInstantiator(Type const& type, CollectionInstantiator collection);

    /// The type of that name; empty if there is none. Where no type has these names, "meta.Model"
    /// and "meta.ModelElement" still stand for the classes of `Model` and `ModelElement`.
    ///
    /// A name of the metamodel of metamodels that is not found, one that begins with "tarn.kiln.",
    /// makes it be built; so do its URIs and its family in the look-ups of packages.
    Type getType(ustring const& name) const;
    /// The same, empty also for a type of another kind.
    Class getClass(ustring const& name) const;
    PrimitiveType getPrimitiveType(ustring const& name) const;

    /// A builder of elements of `metaClass` in `model`; null if that class, and no other of its
    /// name, is not registered with a function for it or as a reflective one.
    std::unique_ptr<ModelElement::Builder> instantiateBuilder(Class const& metaClass,
                                                              Model const& model) const;
    /// A new collection for the many-valued property of `owner`, or a snapshot if that is empty;
    /// the caller owns it.
    ///
    /// | Type of the property | Collection |
    /// |---|---|
    /// | a data type, with a qualifying property | `ReflectiveDataTypeAssociative`; null if that |
    /// |                                         | has many values, no type, or a class as type |
    /// | a data type outside the registry model | `ReflectiveDataTypeSequence` |
    /// | any other | what the function registered with the type makes; null if the type, and |
    /// |           | no other of its name, is not registered with one |
    ///
    /// \throws tarnkiln::messages::UnsupportedQualification  as below.
    AbstractOwnedCollection* instantiateDynamicCollection(ModelElement const& owner,
                                                          Property const& property) const;
    /// A new collection of values of `dataType` by the value of `keyProperty`; the caller owns it.
    ///
    /// \throws tarnkiln::messages::UnsupportedQualification  (qualified name of the key's type)
    ///     unless that is an integral type, a type of texts, `UUID` or an enumeration.
    AbstractOwnedCollection* createReflectiveDataTypeAssociative(DataType const& dataType,
                                                                 Property const& keyProperty,
                                                                 ModelElement const& owner,
                                                                 Property const& property,
                                                                 bool uniqueKeys) const;
    /// @}

    /// \name Packages and families
    /// @{
    /// Enters a package under its URI, in place of any other, and makes it the current one of its
    /// family, whatever its version. The caller holds a `LockedModel`.
    void registerRootPackage(Package const& package);
    /// Takes out the package of that URI, and the current package of its family, whichever that
    /// is. The caller holds a `LockedModel`.
    void unregisterRootPackage(ustring const& uri);
    /// The package of exactly that URI; empty if there is none.
    Package getRootPackage(ustring const& uri) const;
    /// The same; if there is none and `load` is true, its family is loaded first. Must not be
    /// called with `load` under a lock of the registry.
    Package getRootPackage(ustring const& uri, bool load);
    /// The package of the family that was registered last, loaded if there is none; empty if there
    /// is still none. Must not be called under a lock of the registry.
    Package getPackageForFamily(ustring const& family);
    /// Whether `uri` has the version of the current package of its family, which may be loaded for
    /// it. False if there is no such family.
    bool isVersionCurrentForFamily(ustring const& uri);

    /// The version and the family that a package URI names, in this order; both empty for a text
    /// that is no such URI.
    ///
    /// A package URI is `SchemaBase`, a family, "/", a version, and possibly "/" and the qualified
    /// name of a package. Versions are only compared for equality.
    static std::pair<ustring, ustring> parseUri(ustring const& uri);
    /// Whether `uri` has a family and a version, both not empty.
    static bool isValidUri(ustring const& uri);
    /// The URI of a root package, from the parts in the order in which `parseUri` gives them.
    static ustring composeUri(ustring const& version, ustring const& family);
    /// @}

    /// \name Ownership of values
    /// @{
    /// Sets the converter of a type, once: an earlier one stays. Must come before values of the
    /// type exist.
    void registerOwnershipConverter(Type const& type,
                                    std::unique_ptr<ValueOwnershipConverter> converter);
    void unregisterOwnershipConverter(Type const& type);
    /// Whether any type has a converter; without one the two functions below change nothing. Takes
    /// no lock.
    bool hasOwnershipConverters() const { return !m_converters.empty(); }
    /// The copy of `value` that an element may keep. Takes no lock.
    Value convertValueForOwnership(Value const& value);
    /// Lets go of a value that `convertValueForOwnership` gave. Takes no lock.
    void releaseOwnedValue(Value const& value);
    /// @}

private:
    friend class PackageDefinition;

    struct TypeEntry
    {
        BuilderInstantiator builderInstantiator;
        CollectionInstantiator collectionInstantiator;
        Type type;
        bool isReflective = false;  ///< A class whose elements have no generated code.
    };
    /// What look-ups go through.
    struct Directory
    {
        TypeEntry const* findEntry(Type const& type) const;

        std::unordered_map<ustring, TypeEntry> types;       ///< By qualified name.
        std::unordered_map<ustring, Package> rootPackages;  ///< By URI; all versions.
        std::unordered_map<ustring, Package> families;  ///< The package registered last for each.
    };
    class Reading;
    /// The entries of a root package, before they are entered.
    struct RootPackageEntries
    {
        std::unordered_map<ustring, Package> ofUri;
        std::unordered_map<ustring, Package> ofFamily;
    };

    MetaRegistry();
    ~MetaRegistry();

    static MetaRegistry& start();
    void initialize();
    /// Whether this thread holds a `LockedModel`.
    static bool isChangedHere();
    /// The two steps of `registerRootPackage`; the second allocates nothing.
    RootPackageEntries prepareRootPackage(Package const& package);
    void enterRootPackage(RootPackageEntries& made) noexcept;
    void directoryChanged();
    /// Lets look-ups on other threads see what was changed.
    void shareDirectory() noexcept;
    /// Ends the counting of handles of the types that were registered since the last call.
    void publish() noexcept;
    ValueOwnershipConverter* findConverter(Value const& value) const;

    Model m_model;
    Directory m_directory;
    Model::Freezer m_freezer;
    std::unordered_map<Type, std::unique_ptr<ValueOwnershipConverter>, std::hash<ModelElement>>
        m_converters;
    std::vector<Type> m_unpublished;       ///< Registered under the lock that is held.
    mutable std::recursive_mutex m_mutex;  ///< Guards all of the above.
    /// How many `LockedModel`s the one thread holds that holds any.
    std::atomic<int> m_changers{0};
    bool m_directoryChanged = false;  ///< Since the first of them.
    std::unique_ptr<internal::Published<Directory>> m_published;
    bool m_initialised = false;
    std::unique_ptr<internal::UnregisterDestroyedTypes> m_unregisterDestroyedTypes;
};

/// Holds the registry's lock and lets its model be changed, for as long as it lives. Locks nest.
class TARNKILN_EXPORT MetaRegistry::LockedModel
{
public:
    explicit LockedModel(MetaRegistry& registry);
    LockedModel(LockedModel const&) = delete;
    LockedModel& operator=(LockedModel const&) = delete;
    ~LockedModel();

    Model const& getModel() const { return m_model; }

private:
    MetaRegistry& m_registry;
    std::lock_guard<std::recursive_mutex> m_lock;
    Model m_model;
    Model::Thawer m_thawer;
};

/// Holds the registry's lock for as long as it lives; the model stays frozen.
class TARNKILN_EXPORT MetaRegistry::LockedConstModel
{
public:
    explicit LockedConstModel(MetaRegistry const& registry);
    LockedConstModel(LockedConstModel const&) = delete;
    LockedConstModel& operator=(LockedConstModel const&) = delete;
    ~LockedConstModel();

    Model const& getModel() const { return m_model; }

private:
    std::lock_guard<std::recursive_mutex> m_lock;
    Model m_model;
};
}  // namespace tarn::kiln::meta
