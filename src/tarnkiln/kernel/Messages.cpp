#include "tarnkiln/kernel/Messages.h"

namespace tarnkiln::messages {
namespace {

bedrock::core::except::MsgIDObj messageId(char const* name)
{
    return {name, "tarnkiln:messages"};
}
}  // namespace

CannotAddIncompatibleObjectSubset::CannotAddIncompatibleObjectSubset()
    : Exception(messageId("CannotAddIncompatibleObjectSubset"), {},
                "the objects do not belong to the subset that the collection holds")
{}

CannotAddIncompatibleObjectSubset::~CannotAddIncompatibleObjectSubset() = default;

CannotAddIncompatibleTypes::CannotAddIncompatibleTypes(tarn::kiln::ustring const& collectionType,
                                                       tarn::kiln::ustring const& elementType)
    : Exception(messageId("CannotAddIncompatibleTypes"), {collectionType, elementType},
                "cannot add an element of type '{1}' to a collection of type '{0}'")
{}

CannotAddIncompatibleTypes::~CannotAddIncompatibleTypes() = default;

CannotAddNonExistentObject::CannotAddNonExistentObject()
    : Exception(messageId("CannotAddNonExistentObject"), {},
                "cannot add an empty handle to a collection of elements")
{}

CannotAddNonExistentObject::~CannotAddNonExistentObject() = default;

CannotAddSecondObject::CannotAddSecondObject()
    : Exception(messageId("CannotAddSecondObject"), {},
                "the place for one element is already taken")
{}

CannotAddSecondObject::~CannotAddSecondObject() = default;

CannotCastIncompatibleTypes::CannotCastIncompatibleTypes(
    tarn::kiln::ustring const& qualifiedTypeName)
    : Exception(messageId("CannotCastIncompatibleTypes"), {qualifiedTypeName},
                "the value does not fit the type '{0}'")
{}

CannotCastIncompatibleTypes::~CannotCastIncompatibleTypes() = default;

CannotChangeModel::CannotChangeModel()
    : Exception(messageId("CannotChangeModel"), {}, "the element cannot go to another model")
{}

CannotChangeModel::~CannotChangeModel() = default;

CannotCreateCrossModelAssociation::CannotCreateCrossModelAssociation()
    : Exception(messageId("CannotCreateCrossModelAssociation"), {},
                "the reference must not lead to an element of another model")
{}

CannotCreateCrossModelAssociation::~CannotCreateCrossModelAssociation() = default;

CannotCreateWithoutModel::CannotCreateWithoutModel()
    : Exception(messageId("CannotCreateWithoutModel"), {},
                "the operation needs a live model, and for extensions the registry's")
{}

CannotCreateWithoutModel::~CannotCreateWithoutModel() = default;

CannotInstantiateCollection::CannotInstantiateCollection(
    tarn::kiln::ustring const& qualifiedTypeName)
    : Exception(messageId("CannotInstantiateCollection"), {qualifiedTypeName},
                "cannot make a collection for the type '{0}'")
{}

CannotInstantiateCollection::~CannotInstantiateCollection() = default;

CannotJoinShallowTransaction::CannotJoinShallowTransaction()
    : Exception(
          messageId("CannotJoinShallowTransaction"), {},
          "a model cannot join a constellation while a transaction without undo is open there")
{}

CannotJoinShallowTransaction::~CannotJoinShallowTransaction() = default;

CannotMigrateModel::CannotMigrateModel()
    : Exception(messageId("CannotMigrateModel"), {},
                "cannot migrate the model: it needs a constellation of its own, no open "
                "transaction, and a live constellation to go to")
{}

CannotMigrateModel::~CannotMigrateModel() = default;

CannotModifyProxy::CannotModifyProxy()
    : Exception(messageId("CannotModifyProxy"), {},
                "cannot modify a proxy, only the element that it stands for")
{}

CannotModifyProxy::~CannotModifyProxy() = default;

CannotSetReadOnlyProperty::CannotSetReadOnlyProperty(tarn::kiln::ustring const& propertyName)
    : Exception(messageId("CannotSetReadOnlyProperty"), {propertyName},
                "the property '{0}' may be set only once and already has a value")
{}

CannotSetReadOnlyProperty::~CannotSetReadOnlyProperty() = default;

CannotUsePropertyWithoutType::CannotUsePropertyWithoutType(tarn::kiln::ustring const& propertyName)
    : Exception(messageId("CannotUsePropertyWithoutType"), {propertyName},
                "the property '{0}' has no type")
{}

CannotUsePropertyWithoutType::~CannotUsePropertyWithoutType() = default;

ChangesProhibited::ChangesProhibited()
    : Exception(messageId("ChangesProhibited"), {},
                "changes are prohibited while a transaction is validated or rolled back")
{}

ChangesProhibited::~ChangesProhibited() = default;

CircularContainment::CircularContainment()
    : Exception(messageId("CircularContainment"), {},
                "an element cannot contain itself, directly or through others")
{}

CircularContainment::~CircularContainment() = default;

CreateWithDestroyAll::CreateWithDestroyAll()
    : Exception(messageId("CreateWithDestroyAll"), {},
                "cannot create an element in a transaction that destroys all elements")
{}

CreateWithDestroyAll::~CreateWithDestroyAll() = default;

DuplicateFQN::DuplicateFQN(tarn::kiln::string const& qualifiedName)
    : Exception(messageId("DuplicateFQN"), {qualifiedName},
                "the qualified name '{0}' is registered twice")
{}

DuplicateFQN::~DuplicateFQN() = default;

DuplicateTypeInRegistry::DuplicateTypeInRegistry(tarn::kiln::ustring const& typeName)
    : Exception(messageId("DuplicateTypeInRegistry"), {typeName},
                "the type '{0}' is already registered")
{}

DuplicateTypeInRegistry::~DuplicateTypeInRegistry() = default;

ExtensionMustHaveDefaultValue::ExtensionMustHaveDefaultValue()
    : Exception(messageId("ExtensionMustHaveDefaultValue"), {},
                "a single-valued extension needs a default value unless its type is a class")
{}

ExtensionMustHaveDefaultValue::~ExtensionMustHaveDefaultValue() = default;

ExtensionMustHaveName::ExtensionMustHaveName()
    : Exception(messageId("ExtensionMustHaveName"), {}, "an extension needs a name")
{}

ExtensionMustHaveName::~ExtensionMustHaveName() = default;

ExtensionNameMustBeUnique::ExtensionNameMustBeUnique()
    : Exception(messageId("ExtensionNameMustBeUnique"), {},
                "the name of an extension must be unique along a line of inheritance")
{}

ExtensionNameMustBeUnique::~ExtensionNameMustBeUnique() = default;

GetOldValueFromNonDeep::GetOldValueFromNonDeep()
    : Exception(messageId("GetOldValueFromNonDeep"), {},
                "a report without undo information has no old values")
{}

GetOldValueFromNonDeep::~GetOldValueFromNonDeep() = default;

InvalidValue::InvalidValue()
    : Exception(messageId("InvalidValue"), {}, "the value has a shape that is not valid here")
{}

InvalidValue::~InvalidValue() = default;

ModelFrozen::ModelFrozen()
    : Exception(messageId("ModelFrozen"), {}, "the model is frozen or no longer alive")
{}

ModelFrozen::~ModelFrozen() = default;

NoOpenTransaction::NoOpenTransaction()
    : Exception(messageId("NoOpenTransaction"), {},
                "the change needs an open transaction that can be committed")
{}

NoOpenTransaction::~NoOpenTransaction() = default;

NoSuchExtension::NoSuchExtension(tarn::kiln::ustring const& extensionName,
                                 tarn::kiln::ustring const& qualifiedClassName)
    : Exception(messageId("NoSuchExtension"), {extensionName, qualifiedClassName},
                "the class '{1}' has no extension '{0}'")
{}

NoSuchExtension::~NoSuchExtension() = default;

NoSuchOperation::NoSuchOperation(tarn::kiln::ustring const& operationName,
                                 tarn::kiln::ustring const& qualifiedClassName)
    : Exception(messageId("NoSuchOperation"), {operationName, qualifiedClassName},
                "the class '{1}' has no operation '{0}'")
{}

NoSuchOperation::~NoSuchOperation() = default;

NoSuchProperty::NoSuchProperty(tarn::kiln::ustring const& propertyName,
                               tarn::kiln::ustring const& qualifiedClassName)
    : Exception(messageId("NoSuchProperty"), {propertyName, qualifiedClassName},
                "the class '{1}' has no property '{0}' that can be reached here")
{}

NoSuchProperty::~NoSuchProperty() = default;

NoSuchType::NoSuchType(tarn::kiln::ustring const& typeName)
    : Exception(messageId("NoSuchType"), {typeName}, "there is no usable type '{0}'")
{}

NoSuchType::~NoSuchType() = default;

UUIDConflict::UUIDConflict()
    : Exception(messageId("UUIDConflict"), {}, "the model already has an element with this UUID")
{}

UUIDConflict::~UUIDConflict() = default;

UniquenessConstraint::UniquenessConstraint()
    : Exception(messageId("UniquenessConstraint"), {}, "the key, name or model id is already taken")
{}

UniquenessConstraint::~UniquenessConstraint() = default;

UnsupportedQualification::UnsupportedQualification(tarn::kiln::ustring const& qualifiedTypeName)
    : Exception(messageId("UnsupportedQualification"), {qualifiedTypeName},
                "the type '{0}' cannot be the key of a collection")
{}

UnsupportedQualification::~UnsupportedQualification() = default;
}  // namespace tarnkiln::messages
