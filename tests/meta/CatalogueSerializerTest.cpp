// The text forms and fields of the types that come with the catalogue.
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumPropertySerializer.h"
#include "tarnkiln/meta/ExtensionPrototypeDatatypeSerializer.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/TransactionOriginDatatypeSerializer.h"
#include "tarnkiln/meta/TransientOnlyPropertySerializer.h"
#include "tests/meta/SerializerText.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Uuids.h"

#include <tuple>

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::read;
using tarnkiln::tests::serializerOf;
using tarnkiln::tests::write;

class TypeOfTheCatalogue : public ::testing::Test
{
protected:
    TypeOfTheCatalogue() { MetaPackageMeta::getInstance(); }

    static Type typeOf(ustring const& name)
    {
        return MetaRegistry::getInstance().getType(u"tarn.kiln." + name);
    }
    static DataType dataTypeOf(ustring const& name) { return DataType::cast(typeOf(name)); }
    static DatatypeSerializer* serializerOfDataType(DataType const& type)
    {
        return PropertySerializerRegistry::getInstance().getDatatypeSerializer(type);
    }
    static Value fieldOf(Value const& value, ustring const& name)
    {
        DataType const type = DataType::cast(value.getType());
        return serializerOfDataType(type)->getPropertyValue(value,
                                                            type->getOwnedAttributes().find(name));
    }
};

TEST_F(TypeOfTheCatalogue, WritesLanguagesByNameNumberAndPublicIdentifier)
{
    Type const language = typeOf(u"meta.Language");

    EXPECT_EQ(write(language, Language::CPlusPlus), u"CPlusPlus");
    EXPECT_EQ(write(language, Language::JavaScript, "ID"), u"2");
    EXPECT_EQ(read<Language>(language, u"JavaScript"), Language::JavaScript);
    EXPECT_EQ(read<Language>(language, u"1", "ID"), Language::CPlusPlus);
    EXPECT_UNREADABLE(u"Fortran", language);
    EXPECT_UNREADABLE(u"3", language, "ID");
    for (Language const each : {Language::Unknown, Language::CPlusPlus, Language::JavaScript})
        EXPECT_NE(write(language, each, "PublicID"), u"");
    using AsName = DefaultPropertySerializer<Language>;
    EXPECT_TRUE(dynamic_cast<AsName*>(&serializerOf(language)));
    EXPECT_TRUE(dynamic_cast<EnumPropertySerializerAsName<Language>*>(&serializerOf(language)));
    EXPECT_TRUE(
        dynamic_cast<EnumPropertySerializerAsValue<Language>*>(&serializerOf(language, "ID")));
    EXPECT_TRUE(dynamic_cast<EnumPropertySerializerAsPublicId<Language>*>(
        &serializerOf(language, "PublicID")));
}

TEST_F(TypeOfTheCatalogue, StartsLanguagesAsUnknownAndCollectsThem)
{
    Type const language = typeOf(u"meta.Language");
    PropertySerializer& serializer = serializerOf(language);
    Value const script(language, Language::JavaScript);

    EXPECT_EQ(serializer.createDefaultValue(language), Value(language, Language::Unknown));
    EXPECT_EQ(serializer.parseOptionalValue(u"JavaScript", language), script);
    EXPECT_EQ(serializer.combineAsUnmanagedSequenceValue(language, {script, script})
                  .getValue<std::vector<Language>>(),
              (std::vector<Language>{Language::JavaScript, Language::JavaScript}));
    EXPECT_EQ(serializer.combineAsUnmanagedSetValue(language, {script, script})
                  .getValue<std::set<Language>>(),
              std::set<Language>{Language::JavaScript});
}

TEST_F(TypeOfTheCatalogue, WritesNoModel)
{
    Type const type = typeOf(u"TarnModel");
    Model const model = Model::createRegistryModel(u"transient");

    EXPECT_TRUE(dynamic_cast<TransientOnlyPropertySerializer<Model>*>(&serializerOf(type)));
    EXPECT_EQ(write(type, model), u"");
    EXPECT_FALSE(read<Model>(type, u"transient"));
}

TEST_F(TypeOfTheCatalogue, TakesOriginsOfTransactionsApart)
{
    DataType const type = dataTypeOf(u"meta.TransactionOrigin");
    TransactionOrigin origin;
    origin.setModel(testkit::uuidOf(1));
    origin.setLanguage(Language::JavaScript);
    origin.setTransactionId(testkit::uuidOf(2));
    origin.setSynchronizer(testkit::uuidOf(3));
    Value const value(type, origin);

    ASSERT_TRUE(dynamic_cast<TransactionOriginDatatypeSerializer*>(serializerOfDataType(type)));
    EXPECT_EQ(fieldOf(value, u"model").getValue<UUID>(), testkit::uuidOf(1));
    EXPECT_EQ(fieldOf(value, u"language").getValue<Language>(), Language::JavaScript);
    EXPECT_EQ(fieldOf(value, u"transactionId").getValue<UUID>(), testkit::uuidOf(2));
    EXPECT_TRUE(fieldOf(value, u"synchronizer").getValue<boost::optional<UUID>>() ==
                testkit::uuidOf(3));
    EXPECT_EQ(value.toReflectiveDataType().toNonReflectiveDataTypeValue().value(), value);
    EXPECT_EQ(serializerOfDataType(type)->createDefaultValue(), Value(type, TransactionOrigin()));
}

TEST_F(TypeOfTheCatalogue, TakesPrototypesOfExtensionsApart)
{
    DataType const type = dataTypeOf(u"meta.ExtensionPrototype");
    ExtensionPrototype prototype;
    prototype.setUpper(0xFFFFFFFF);
    prototype.setName(u"note");
    Value const value(type, prototype);

    ASSERT_TRUE(dynamic_cast<ExtensionPrototypeDatatypeSerializer*>(serializerOfDataType(type)));
    EXPECT_EQ(fieldOf(value, u"upper").getValue<unsigned int>(), 0xFFFFFFFF);
    EXPECT_EQ(fieldOf(value, u"name").getValue<ustring>(), u"note");
    EXPECT_EQ(value.toReflectiveDataType().toNonReflectiveDataTypeValue().value(), value);
    EXPECT_EQ(Value::createEmptyValue(type, true), Value(type, ExtensionPrototype()));
    EXPECT_TRUE(Value::createEmptyValue(type, false).isAbsent());
}

TEST_F(TypeOfTheCatalogue, HasCollectionsOrderedByItsOwnComparison)
{
    DataType const type = dataTypeOf(u"meta.TransactionOrigin");
    TransactionOrigin first;
    TransactionOrigin second;
    second.setSynchronizer(testkit::uuidOf(1));

    Value const set = serializerOfDataType(type)->combineAsUnmanagedSetValue(
        type, {Value(type, second), Value(type, first), Value(type, second)});

    EXPECT_EQ(set.extractEntryValues(),
              (std::vector<Value>{Value(type, first), Value(type, second)}))
        << "an absent synchronizer comes first";
}

TEST_F(TypeOfTheCatalogue, IsNamedWhenAValueHasNoFields)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(StandardTypes::integerMeta, 1).toReflectiveDataType(),
                       u"tarn.kiln.meta.DataType");
}
}  // namespace
}  // namespace tarn::kiln::meta
