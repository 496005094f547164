#include "tarnkiln/meta/PropertySerializerRegistry.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/UUIDHasher.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/kernel/reportException.h"
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/DateTimePropertySerializers.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertySerializerBoolean.h"
#include "tarnkiln/meta/PropertySerializerDouble.h"
#include "tarnkiln/meta/PropertySerializerLexicalCastable.h"
#include "tarnkiln/meta/ReflectiveEnumPropertySerializer.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/StringPropertySerializer.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/meta/internal/Published.h"

#include <algorithm>
#include <exception>
#include <map>
#include <mutex>
#include <unordered_map>

namespace tarn::kiln::meta {
namespace {

struct Entry
{
    Type type;  ///< Alive or dead.
    string flavour;
    std::unique_ptr<PropertySerializer> serializer;
};

/// Those of one type in the order of registration.
using Entries = std::vector<Entry>;

struct DatatypeEntry
{
    Type type;  ///< Alive or dead.
    std::unique_ptr<DatatypeSerializer> serializer;
};

template <class AnyEntries> auto findFlavour(AnyEntries& entries, string const& flavour)
{
    return std::find_if(entries.begin(), entries.end(),
                        [&](auto const& entry) { return entry.flavour == flavour; });
}

/// What look-ups go through: the serializers, which others own, and no types.
struct Directory
{
    struct Entry
    {
        string flavour;
        PropertySerializer* serializer;
    };

    std::unordered_map<UUID, std::vector<Entry>, internal::UUIDHasher> byType;
    std::unordered_map<UUID, DatatypeSerializer*, internal::UUIDHasher> byDataType;
};

/// The registered type with the qualified name of `type`; empty if that is `type` itself.
Type namesakeOf(Type const& type)
{
    Type const found = MetaRegistry::getInstance().getType(internal::qualifiedName(type));
    return found && found != type ? found : Type();
}
}  // namespace

/// The lock is held only while the tables are used, never while a serializer or another registry
/// is asked: it is not recursive, and the lock of `MetaRegistry` is taken before it. Look-ups take
/// it only after a change, to make a copy of what they need.
struct PropertySerializerRegistry::Tables
{
    template <class Serializer> void add(Type const& type, char const* flavour)
    {
        byType[type.getElementImpl()->getUuid()].push_back(
            {type, flavour, std::make_unique<Serializer>(type)});
    }
    Directory copy() const
    {
        Directory result;
        for (auto const& [type, entries] : byType)
        {
            for (Entry const& entry : entries)
                result.byType[type].push_back({entry.flavour, entry.serializer.get()});
        }
        for (auto const& [type, entry] : byDataType)
            result.byDataType.emplace(type, entry.serializer.get());
        return result;
    }
    /// The latest directory, which stays good until this thread's next call; where the thread ends
    /// and can keep none, it is moved to `own`.
    Directory const& latest(Directory& own)
    {
        if (Directory const* const found = published.find())
            return *found;
        std::lock_guard const lock(mutex);
        auto made = std::make_shared<Directory const>(copy());
        published.publish(made);
        if (Directory const* const found = published.find())
            return *found;
        own = *made;
        return own;
    }

    std::unordered_map<UUID, Entries, internal::UUIDHasher> byType;
    std::unordered_map<UUID, DatatypeEntry, internal::UUIDHasher> byDataType;
    std::mutex mutex;
    internal::Published<Directory> published;
    /// By flavour; for enumerations without a serializer of their own.
    std::map<string, std::unique_ptr<PropertySerializer>> ofEnumerations;
};

PropertySerializerRegistry& PropertySerializerRegistry::getInstance()
{
    // Before the guard of the static is entered: a thread that holds the registry's lock may wait
    // for the guard.
    StandardTypes::ensureInitialized();
    static PropertySerializerRegistry* const instance = new PropertySerializerRegistry;
    return *instance;
}

PropertySerializerRegistry::PropertySerializerRegistry() : m_tables(std::make_unique<Tables>())
{
    initialize();
}

PropertySerializerRegistry::~PropertySerializerRegistry() = default;

void PropertySerializerRegistry::initialize()
{
    using Types = StandardTypes;
    Tables& tables = *m_tables;
    tables.add<PropertySerializerLexicalCastable<string>>(Types::stdstringMeta, "");
    tables.add<PropertySerializerLexicalCastable<int>>(Types::integerMeta, "");
    tables.add<PropertySerializerIntLexicalCastable<signed char>>(Types::integer8Meta, "");
    tables.add<PropertySerializerLexicalCastable<short>>(Types::integer16Meta, "");
    tables.add<PropertySerializerLexicalCastable<long>>(Types::integer64Meta, "");
    tables.add<PropertySerializerDouble>(Types::realMeta, "");
    tables.add<PropertySerializerDoubleBackwardsCompatible>(Types::realMeta,
                                                            "doubleBackwardsCompatible");
    tables.add<PropertySerializerBoolean>(Types::booleanMeta, "");
    tables.add<PropertySerializerLexicalCastable<bool>>(Types::booleanMeta, "numeric");
    tables.add<PropertySerializerLexicalCastable<unsigned int>>(Types::unlimitedNaturalMeta, "");
    tables.add<PropertySerializerIntLexicalCastable<unsigned char>>(Types::uinteger8Meta, "");
    tables.add<PropertySerializerLexicalCastable<unsigned short>>(Types::uinteger16Meta, "");
    tables.add<PropertySerializerLexicalCastable<unsigned long>>(Types::uinteger64Meta, "");
    tables.add<PropertySerializerLexicalCastable<UUID>>(Types::uuidMeta, "");
    tables.add<StringPropertySerializer>(Types::stringMeta, "");
    tables.add<DefaultDateTimeSerializer>(Types::dateTimeMeta, "");
    tables.add<DateTimeSerializerRev17>(Types::dateTimeMeta, "Rev17");

    auto& enums = tables.ofEnumerations;
    enums.emplace("", std::make_unique<ReflectiveEnumPropertySerializerAsName>());
    enums.emplace("ID", std::make_unique<ReflectiveEnumPropertySerializerAsValue>());
    enums.emplace("PublicID", std::make_unique<ReflectiveEnumPropertySerializerAsPublicId>());
}

void PropertySerializerRegistry::registerPropertySerializer(
    Type const& type, std::unique_ptr<PropertySerializer> serializer, string const& flavour)
{
    {
        std::lock_guard const lock(m_tables->mutex);
        m_tables->published.publish(nullptr);
        Entries& entries = m_tables->byType[type->getUuid()];
        auto const place = findFlavour(entries, flavour);
        if (place == entries.end())
        {
            entries.push_back({type, flavour, std::move(serializer)});
            return;
        }
        // What a rolled back metamodel leaves behind must not keep it from being built again.
        if (!place->type)
        {
            *place = {type, flavour, std::move(serializer)};
            return;
        }
    }
    reportException(tarnkiln::messages::DuplicateTypeInRegistry(internal::qualifiedName(type)));
}

void PropertySerializerRegistry::registerDatatypeSerializer(
    DataType const& type, std::unique_ptr<DatatypeSerializer> serializer)
{
    {
        std::lock_guard const lock(m_tables->mutex);
        m_tables->published.publish(nullptr);
        DatatypeEntry& entry = m_tables->byDataType[type.getElementImpl()->getUuid()];
        if (!entry.type)
        {
            entry = {type, std::move(serializer)};
            return;
        }
    }
    reportException(tarnkiln::messages::DuplicateTypeInRegistry(internal::qualifiedName(type)));
}

void PropertySerializerRegistry::unregisterPropertySerializer(Type const& type,
                                                              string const& flavour)
{
    std::lock_guard const lock(m_tables->mutex);
    auto const position = m_tables->byType.find(type->getUuid());
    if (position == m_tables->byType.end())
        return;
    m_tables->published.publish(nullptr);
    std::erase_if(position->second, [&](Entry const& entry) { return entry.flavour == flavour; });
    if (position->second.empty())
        m_tables->byType.erase(position);
}

void PropertySerializerRegistry::unregisterSerializers(Type const& type)
{
    std::lock_guard const lock(m_tables->mutex);
    m_tables->published.publish(nullptr);
    m_tables->byType.erase(type->getUuid());
    m_tables->byDataType.erase(type->getUuid());
}

PropertySerializer* PropertySerializerRegistry::getPropertySerializer(Type const& type,
                                                                      string const& flavour) const
{
    if (PropertySerializer* const own = getPropertySerializerForTypeOnly(type, flavour))
        return own;
    if (!PrimitiveType::cast(type))
        return nullptr;
    return getPropertySerializerForTypeOnly(namesakeOf(type), flavour);
}

PropertySerializer*
PropertySerializerRegistry::getPropertySerializerForTypeOnly(Type const& type,
                                                             string const& flavour) const
{
    if (!type.getElementImpl())
        return nullptr;
    Directory own;
    Directory const& directory = m_tables->latest(own);
    auto const position = directory.byType.find(type->getUuid());
    if (position != directory.byType.end())
    {
        auto const place = findFlavour(position->second, flavour);
        if (place != position->second.end())
            return place->serializer;
    }
    // Tells the kind of type by its C++ class: to ask for a metaclass may build metamodels.
    if (!internal::isEnumType(type))
        return nullptr;
    auto const shared = m_tables->ofEnumerations.find(flavour);
    return shared != m_tables->ofEnumerations.end() ? shared->second.get() : nullptr;
}

DatatypeSerializer* PropertySerializerRegistry::getDatatypeSerializer(DataType const& type) const
{
    if (!type.getElementImpl())
        return nullptr;
    Directory own;
    Directory const& directory = m_tables->latest(own);
    auto const position = directory.byDataType.find(type.getElementImpl()->getUuid());
    return position != directory.byDataType.end() ? position->second : nullptr;
}

boost::optional<std::pair<Value, PropertySerializer*>>
PropertySerializerRegistry::parseInAnyFlavour(ustring const& text, Type const& type) const
{
    for (PropertySerializer* const serializer : getAllFlavours(type))
    {
        try
        {
            return std::pair(serializer->parseValue(text, type), serializer);
        }
        catch (std::exception const&)
        {
            // Another flavour may know the text.
        }
    }
    Type const namesake = namesakeOf(type);
    // The registered type is its own namesake, so this goes one step deep.
    if (namesake)
        return parseInAnyFlavour(text, namesake);
    return boost::none;
}

std::vector<PropertySerializer*> PropertySerializerRegistry::getAllFlavours(Type const& type) const
{
    std::vector<PropertySerializer*> result;
    Directory own;
    Directory const& directory = m_tables->latest(own);
    auto const position = directory.byType.find(type->getUuid());
    if (position == directory.byType.end())
        return result;
    result.reserve(position->second.size());
    for (Directory::Entry const& entry : position->second)
        result.push_back(entry.serializer);
    return result;
}
}  // namespace tarn::kiln::meta
