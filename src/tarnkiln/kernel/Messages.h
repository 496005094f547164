/// \file
/// The failures of the kernel, the metamodel and the collections: catalogue "tarnkiln:messages".
///
///     reportException(tarnkiln::messages::NoSuchType(typeName));
///
///     try { ... }
///     catch (tarnkiln::messages::NoSuchType const& failure) { use(failure.getArguments()); }
///
/// Each class is named like the id that it carries. The arguments of a constructor are the
/// arguments of the exception, in that order.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/reportException.h"

namespace tarnkiln::messages {

/// Objects of a wrong subset are given to a collection that shows one kind of object only.
class TARNKILN_EXPORT CannotAddIncompatibleObjectSubset final
    : public tarn::kiln::MessageException<CannotAddIncompatibleObjectSubset>
{
public:
    CannotAddIncompatibleObjectSubset();
    ~CannotAddIncompatibleObjectSubset() override;
};

/// The class of an element does not fit the reference collection that it is added to.
class TARNKILN_EXPORT CannotAddIncompatibleTypes final
    : public tarn::kiln::MessageException<CannotAddIncompatibleTypes>
{
public:
    CannotAddIncompatibleTypes(tarn::kiln::ustring const& collectionType,
                               tarn::kiln::ustring const& elementType);
    ~CannotAddIncompatibleTypes() override;
};

/// An empty element handle is added to a reference collection.
class TARNKILN_EXPORT CannotAddNonExistentObject final
    : public tarn::kiln::MessageException<CannotAddNonExistentObject>
{
public:
    CannotAddNonExistentObject();
    ~CannotAddNonExistentObject() override;
};

/// A slot or a unique sequence that may hold one element is given another or the same again.
class TARNKILN_EXPORT CannotAddSecondObject final
    : public tarn::kiln::MessageException<CannotAddSecondObject>
{
public:
    CannotAddSecondObject();
    ~CannotAddSecondObject() override;
};

/// A `Value` is read as something it does not hold, or a property is given a value of a wrong type.
class TARNKILN_EXPORT CannotCastIncompatibleTypes final
    : public tarn::kiln::MessageException<CannotCastIncompatibleTypes>
{
public:
    explicit CannotCastIncompatibleTypes(tarn::kiln::ustring const& qualifiedTypeName);
    ~CannotCastIncompatibleTypes() override;
};

/// Containment would reach across models, or a model's contents cannot be moved to the given one.
class TARNKILN_EXPORT CannotChangeModel final
    : public tarn::kiln::MessageException<CannotChangeModel>
{
public:
    CannotChangeModel();
    ~CannotChangeModel() override;
};

/// A reference would lead into a model that the property or the models do not allow.
class TARNKILN_EXPORT CannotCreateCrossModelAssociation final
    : public tarn::kiln::MessageException<CannotCreateCrossModelAssociation>
{
public:
    CannotCreateCrossModelAssociation();
    ~CannotCreateCrossModelAssociation() override;
};

/// An element is created without a live model, or a class outside the registry model is extended.
class TARNKILN_EXPORT CannotCreateWithoutModel final
    : public tarn::kiln::MessageException<CannotCreateWithoutModel>
{
public:
    CannotCreateWithoutModel();
    ~CannotCreateWithoutModel() override;
};

/// No collection can be made for the type of a many-valued extension.
class TARNKILN_EXPORT CannotInstantiateCollection final
    : public tarn::kiln::MessageException<CannotInstantiateCollection>
{
public:
    explicit CannotInstantiateCollection(tarn::kiln::ustring const& qualifiedTypeName);
    ~CannotInstantiateCollection() override;
};

/// A model joins a constellation whose open transaction group is shallow.
class TARNKILN_EXPORT CannotJoinShallowTransaction final
    : public tarn::kiln::MessageException<CannotJoinShallowTransaction>
{
public:
    CannotJoinShallowTransaction();
    ~CannotJoinShallowTransaction() override;
};

/// A model cannot leave its constellation for another one.
class TARNKILN_EXPORT CannotMigrateModel final
    : public tarn::kiln::MessageException<CannotMigrateModel>
{
public:
    CannotMigrateModel();
    ~CannotMigrateModel() override;
};

/// A setter is called on an element that only stands in for another.
class TARNKILN_EXPORT CannotModifyProxy final
    : public tarn::kiln::MessageException<CannotModifyProxy>
{
public:
    CannotModifyProxy();
    ~CannotModifyProxy() override;
};

/// A property that may be set once already has a value.
class TARNKILN_EXPORT CannotSetReadOnlyProperty final
    : public tarn::kiln::MessageException<CannotSetReadOnlyProperty>
{
public:
    explicit CannotSetReadOnlyProperty(tarn::kiln::ustring const& propertyName);
    ~CannotSetReadOnlyProperty() override;
};

/// A property without a type is met while a reflective element or data type is built.
class TARNKILN_EXPORT CannotUsePropertyWithoutType final
    : public tarn::kiln::MessageException<CannotUsePropertyWithoutType>
{
public:
    explicit CannotUsePropertyWithoutType(tarn::kiln::ustring const& propertyName);
    ~CannotUsePropertyWithoutType() override;
};

/// Something would be recorded while a transaction is validated or rolled back.
class TARNKILN_EXPORT ChangesProhibited final
    : public tarn::kiln::MessageException<ChangesProhibited>
{
public:
    ChangesProhibited();
    ~ChangesProhibited() override;
};

/// An element would contain itself, directly or through others.
class TARNKILN_EXPORT CircularContainment final
    : public tarn::kiln::MessageException<CircularContainment>
{
public:
    CircularContainment();
    ~CircularContainment() override;
};

/// An element is created in a transaction that has announced the destruction of all elements.
class TARNKILN_EXPORT CreateWithDestroyAll final
    : public tarn::kiln::MessageException<CreateWithDestroyAll>
{
public:
    CreateWithDestroyAll();
    ~CreateWithDestroyAll() override;
};

/// Two services announce the same qualified name.
class TARNKILN_EXPORT DuplicateFQN final : public tarn::kiln::MessageException<DuplicateFQN>
{
public:
    explicit DuplicateFQN(tarn::kiln::string const& qualifiedName);
    ~DuplicateFQN() override;
};

/// A type or its serializer is registered twice.
class TARNKILN_EXPORT DuplicateTypeInRegistry final
    : public tarn::kiln::MessageException<DuplicateTypeInRegistry>
{
public:
    explicit DuplicateTypeInRegistry(tarn::kiln::ustring const& typeName);
    ~DuplicateTypeInRegistry() override;
};

/// A single-valued extension of a type other than a class comes without a default value.
class TARNKILN_EXPORT ExtensionMustHaveDefaultValue final
    : public tarn::kiln::MessageException<ExtensionMustHaveDefaultValue>
{
public:
    ExtensionMustHaveDefaultValue();
    ~ExtensionMustHaveDefaultValue() override;
};

/// An extension prototype has an empty name.
class TARNKILN_EXPORT ExtensionMustHaveName final
    : public tarn::kiln::MessageException<ExtensionMustHaveName>
{
public:
    ExtensionMustHaveName();
    ~ExtensionMustHaveName() override;
};

/// The name of an extension clashes with another one's along a line of inheritance.
class TARNKILN_EXPORT ExtensionNameMustBeUnique final
    : public tarn::kiln::MessageException<ExtensionNameMustBeUnique>
{
public:
    ExtensionNameMustBeUnique();
    ~ExtensionNameMustBeUnique() override;
};

/// An old value is asked of the report of a transaction that kept none.
class TARNKILN_EXPORT GetOldValueFromNonDeep final
    : public tarn::kiln::MessageException<GetOldValueFromNonDeep>
{
public:
    GetOldValueFromNonDeep();
    ~GetOldValueFromNonDeep() override;
};

/// A value has a wrong shape, a model URI cannot be used, or a model id has no colon.
class TARNKILN_EXPORT InvalidValue final : public tarn::kiln::MessageException<InvalidValue>
{
public:
    InvalidValue();
    ~InvalidValue() override;
};

/// A frozen model is changed, or a transaction is begun on a dead one.
class TARNKILN_EXPORT ModelFrozen final : public tarn::kiln::MessageException<ModelFrozen>
{
public:
    ModelFrozen();
    ~ModelFrozen() override;
};

/// A change needs a transaction and none is open, or an internal commit failed.
class TARNKILN_EXPORT NoOpenTransaction final
    : public tarn::kiln::MessageException<NoOpenTransaction>
{
public:
    NoOpenTransaction();
    ~NoOpenTransaction() override;
};

/// A class has no extension of this name.
class TARNKILN_EXPORT NoSuchExtension final : public tarn::kiln::MessageException<NoSuchExtension>
{
public:
    NoSuchExtension(tarn::kiln::ustring const& extensionName,
                    tarn::kiln::ustring const& qualifiedClassName);
    ~NoSuchExtension() override;
};

/// A class has no operation of this name, or an abstract class is asked to create an element.
class TARNKILN_EXPORT NoSuchOperation final : public tarn::kiln::MessageException<NoSuchOperation>
{
public:
    NoSuchOperation(tarn::kiln::ustring const& operationName,
                    tarn::kiln::ustring const& qualifiedClassName);
    ~NoSuchOperation() override;
};

/// A class has no property of this name, or none that the caller may reach.
class TARNKILN_EXPORT NoSuchProperty final : public tarn::kiln::MessageException<NoSuchProperty>
{
public:
    NoSuchProperty(tarn::kiln::ustring const& propertyName,
                   tarn::kiln::ustring const& qualifiedClassName);
    ~NoSuchProperty() override;
};

/// No type has this name, or a proxy is asked of a class that cannot be used.
class TARNKILN_EXPORT NoSuchType final : public tarn::kiln::MessageException<NoSuchType>
{
public:
    explicit NoSuchType(tarn::kiln::ustring const& typeName);
    ~NoSuchType() override;
};

/// A model would hold two elements with one UUID.
class TARNKILN_EXPORT UUIDConflict final : public tarn::kiln::MessageException<UUIDConflict>
{
public:
    UUIDConflict();
    ~UUIDConflict() override;
};

/// A key, a name or a model id is already taken.
class TARNKILN_EXPORT UniquenessConstraint final
    : public tarn::kiln::MessageException<UniquenessConstraint>
{
public:
    UniquenessConstraint();
    ~UniquenessConstraint() override;
};

/// A map property is keyed by a type for which there is no collection.
class TARNKILN_EXPORT UnsupportedQualification final
    : public tarn::kiln::MessageException<UnsupportedQualification>
{
public:
    explicit UnsupportedQualification(tarn::kiln::ustring const& qualifiedTypeName);
    ~UnsupportedQualification() override;
};
}  // namespace tarnkiln::messages
