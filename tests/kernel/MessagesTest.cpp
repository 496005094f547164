#include "tarnkiln/kernel/Messages.h"

#include "tests/support/ExpectRaises.h"

#include <exception>
#include <functional>
#include <memory>
#include <set>
#include <stdexcept>
#include <string>
#include <typeinfo>
#include <utility>
#include <vector>

namespace {

using bedrock::core::except::Argument;
using bedrock::core::except::ExceptionBase;
using bedrock::core::except::MsgIDObj;
using tarn::kiln::reportException;

/// One id of the catalogue with what every exception of its class must carry.
struct Message
{
    std::string id;
    std::vector<Argument> arguments;
    std::string text;
    std::function<void()> raise;
    std::function<bool(ExceptionBase const&)> isOfIdClass;
    std::function<bool(std::function<void()> const&)> isCaughtByIdClass;
};

template <class Id> Message message(std::string id, std::string text, auto const&... arguments)
{
    return {std::move(id),
            {Argument(arguments)...},
            std::move(text),
            [=] { reportException(Id(arguments...)); },
            [](ExceptionBase const& exception) { return typeid(exception) == typeid(Id); },
            [](std::function<void()> const& call) {
                try
                {
                    call();
                }
                catch (Id const&)
                {
                    return true;
                }
                return false;
            }};
}

/// The whole catalogue.
std::vector<Message> catalogue()
{
    using namespace tarnkiln::messages;
    std::u16string const a = u"a.\u00E9";
    std::u16string const b = u"b.\U0001F525";

    return {
        message<CannotAddIncompatibleObjectSubset>(
            "CannotAddIncompatibleObjectSubset",
            "the objects do not belong to the subset that the collection holds"),
        message<CannotAddIncompatibleTypes>(
            "CannotAddIncompatibleTypes",
            "cannot add an element of type 'b.\U0001F525' to a collection of type 'a.\u00E9'", a,
            b),
        message<CannotAddNonExistentObject>(
            "CannotAddNonExistentObject", "cannot add an empty handle to a collection of elements"),
        message<CannotAddSecondObject>("CannotAddSecondObject",
                                       "the place for one element is already taken"),
        message<CannotCastIncompatibleTypes>("CannotCastIncompatibleTypes",
                                             "the value does not fit the type 'a.\u00E9'", a),
        message<CannotChangeModel>("CannotChangeModel", "the element cannot go to another model"),
        message<CannotCreateCrossModelAssociation>(
            "CannotCreateCrossModelAssociation",
            "the reference must not lead to an element of another model"),
        message<CannotCreateWithoutModel>(
            "CannotCreateWithoutModel",
            "the operation needs a live model, and for extensions the registry's"),
        message<CannotInstantiateCollection>("CannotInstantiateCollection",
                                             "cannot make a collection for the type 'a.\u00E9'", a),
        message<CannotJoinShallowTransaction>(
            "CannotJoinShallowTransaction",
            "a model cannot join a constellation while a transaction without undo is open there"),
        message<CannotMigrateModel>("CannotMigrateModel",
                                    "cannot migrate the model: it needs a constellation of its "
                                    "own, no open transaction, and a live constellation to go to"),
        message<CannotModifyProxy>("CannotModifyProxy",
                                   "cannot modify a proxy, only the element that it stands for"),
        message<CannotSetReadOnlyProperty>(
            "CannotSetReadOnlyProperty",
            "the property 'a.\u00E9' may be set only once and already has a value", a),
        message<CannotUsePropertyWithoutType>("CannotUsePropertyWithoutType",
                                              "the property 'a.\u00E9' has no type", a),
        message<ChangesProhibited>(
            "ChangesProhibited",
            "changes are prohibited while a transaction is validated or rolled back"),
        message<CircularContainment>(
            "CircularContainment", "an element cannot contain itself, directly or through others"),
        message<CreateWithDestroyAll>(
            "CreateWithDestroyAll",
            "cannot create an element in a transaction that destroys all elements"),
        message<DuplicateFQN>("DuplicateFQN", "the qualified name 'x.Y' is registered twice",
                              std::string("x.Y")),
        message<DuplicateTypeInRegistry>("DuplicateTypeInRegistry",
                                         "the type 'a.\u00E9' is already registered", a),
        message<ExtensionMustHaveDefaultValue>(
            "ExtensionMustHaveDefaultValue",
            "a single-valued extension needs a default value unless its type is a class"),
        message<ExtensionMustHaveName>("ExtensionMustHaveName", "an extension needs a name"),
        message<ExtensionNameMustBeUnique>(
            "ExtensionNameMustBeUnique",
            "the name of an extension must be unique along a line of inheritance"),
        message<GetOldValueFromNonDeep>("GetOldValueFromNonDeep",
                                        "a report without undo information has no old values"),
        message<InvalidValue>("InvalidValue", "the value has a shape that is not valid here"),
        message<ModelFrozen>("ModelFrozen", "the model is frozen or no longer alive"),
        message<NoOpenTransaction>("NoOpenTransaction",
                                   "the change needs an open transaction that can be committed"),
        message<NoSuchExtension>("NoSuchExtension",
                                 "the class 'b.\U0001F525' has no extension 'a.\u00E9'", a, b),
        message<NoSuchOperation>("NoSuchOperation",
                                 "the class 'b.\U0001F525' has no operation 'a.\u00E9'", a, b),
        message<NoSuchProperty>(
            "NoSuchProperty",
            "the class 'b.\U0001F525' has no property 'a.\u00E9' that can be reached here", a, b),
        message<NoSuchType>("NoSuchType", "there is no usable type 'a.\u00E9'", a),
        message<UUIDConflict>("UUIDConflict", "the model already has an element with this UUID"),
        message<UniquenessConstraint>("UniquenessConstraint",
                                      "the key, name or model id is already taken"),
        message<UnsupportedQualification>(
            "UnsupportedQualification", "the type 'a.\u00E9' cannot be the key of a collection", a),
    };
}

class MessageOfTheCatalogue : public testing::TestWithParam<Message>
{};

TEST_P(MessageOfTheCatalogue, IsCaughtByItsIdClass)
{
    EXPECT_TRUE(GetParam().isCaughtByIdClass(GetParam().raise));
}

TEST_P(MessageOfTheCatalogue, IsCaughtByTheCommonBaseWithItsIdAndArguments)
{
    try
    {
        GetParam().raise();
        FAIL() << "raised nothing";
    }
    catch (ExceptionBase const& exception)
    {
        EXPECT_EQ(exception.GetBaseMsgIDObj().getID(), GetParam().id);
        EXPECT_EQ(exception.GetBaseMsgIDObj().getCatalogue(), "tarnkiln:messages");
        EXPECT_EQ(exception.getArguments(), GetParam().arguments);
        EXPECT_TRUE(GetParam().isOfIdClass(exception));
    }
}

TEST_P(MessageOfTheCatalogue, IsCaughtAsAStandardExceptionWithItsText)
{
    try
    {
        GetParam().raise();
        FAIL() << "raised nothing";
    }
    catch (std::exception const& exception)
    {
        EXPECT_EQ(exception.what(), GetParam().text);
    }
}

TEST_P(MessageOfTheCatalogue, KeepsEverythingInACloneThatIsRethrown)
{
    std::unique_ptr<ExceptionBase> clone;
    try
    {
        GetParam().raise();
    }
    catch (ExceptionBase const& exception)
    {
        clone = exception.clone();
    }
    ASSERT_TRUE(clone);

    EXPECT_TRUE(GetParam().isCaughtByIdClass([&] { clone->rethrow(); }));
    try
    {
        clone->rethrow();
    }
    catch (ExceptionBase const& exception)
    {
        EXPECT_NE(&exception, clone.get());
        EXPECT_EQ(exception.GetBaseMsgIDObj(), MsgIDObj(GetParam().id, "tarnkiln:messages"));
        EXPECT_EQ(exception.getArguments(), GetParam().arguments);
        EXPECT_EQ(exception.getText(), GetParam().text);
    }
}

TEST_P(MessageOfTheCatalogue, BeginsInLowerCaseAndEndsWithoutFullStop)
{
    std::string const& text = GetParam().text;

    ASSERT_FALSE(text.empty());
    EXPECT_TRUE(text.front() >= 'a' && text.front() <= 'z') << text;
    EXPECT_NE(text.back(), '.') << text;
}

INSTANTIATE_TEST_SUITE_P(All, MessageOfTheCatalogue, testing::ValuesIn(catalogue()),
                         [](auto const& info) { return info.param.id; });

TEST(MessageCatalogue, HasThirtyThreeDifferentIds)
{
    std::set<std::string> ids;
    for (Message const& entry : catalogue())
        ids.insert(entry.id);

    EXPECT_EQ(ids.size(), 33u);
}

TEST(ExpectRaises, TellsWhatWasRaisedInsteadOfTheIdClass)
{
    auto const result = tarnkiln::tests::raises<messages::InvalidValue>(
        [] { reportException(messages::NoSuchType(u"Kiln")); });

    EXPECT_FALSE(result);
    EXPECT_STREQ(result.message(),
                 "raised tarnkiln:messages:NoSuchType: there is no usable type 'Kiln'");
}

TEST(ExpectRaises, TellsWhichArgumentsDiffer)
{
    auto const result = tarnkiln::tests::raises<messages::NoSuchProperty>(
        [] { reportException(messages::NoSuchProperty(u"p", u"C")); },
        tarnkiln::tests::toArguments(u"C", u"p"));

    EXPECT_FALSE(result);
    EXPECT_STREQ(result.message(),
                 "raised with the arguments (u\"p\", u\"C\") instead of (u\"C\", u\"p\")");
}

TEST(ExpectRaises, FailsWhenNothingOrSomethingForeignIsThrown)
{
    EXPECT_STREQ(tarnkiln::tests::raises<messages::InvalidValue>([] {}).message(),
                 "raised nothing");
    EXPECT_STREQ(tarnkiln::tests::raises<messages::InvalidValue>([] {
                     throw std::runtime_error("foreign");
                 }).message(),
                 "threw a std::exception: foreign");
}

TEST(ExpectRaises, AcceptsTheIdClassWithItsArguments)
{
    EXPECT_RAISES(messages::UUIDConflict, reportException(messages::UUIDConflict()));
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       reportException(messages::NoSuchProperty(u"name", u"Class")), u"name",
                       u"Class");
    EXPECT_RAISES_WITH(messages::DuplicateFQN, reportException(messages::DuplicateFQN("x.Y")),
                       "x.Y");
}
}  // namespace
