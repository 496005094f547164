/// \file
/// The failures of queries: catalogue "tarnkiln:query".
///
/// Each class is named like the id that it carries. The arguments of a constructor are the
/// arguments of the exception, in that order.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/reportException.h"

namespace tarnkiln::query {

/// A query is to search a class that is empty or was destroyed.
class TARNKILN_EXPORT InvalidSearchClass final
    : public tarn::kiln::MessageException<InvalidSearchClass>
{
public:
    InvalidSearchClass();
    ~InvalidSearchClass() override;
};

/// A constraint names a search instance that the query has not got.
class TARNKILN_EXPORT NoSuchInstanceId final : public tarn::kiln::MessageException<NoSuchInstanceId>
{
public:
    NoSuchInstanceId();
    ~NoSuchInstanceId() override;
};

/// A query without a search instance is run.
class TARNKILN_EXPORT NoSearchInstances final
    : public tarn::kiln::MessageException<NoSearchInstances>
{
public:
    NoSearchInstances();
    ~NoSearchInstances() override;
};

/// A query is run whose model is empty or was destroyed.
class TARNKILN_EXPORT NoModel final : public tarn::kiln::MessageException<NoModel>
{
public:
    NoModel();
    ~NoModel() override;
};

/// A property is compared with a collection.
class TARNKILN_EXPORT PropertyRelationValueNotPrimitive final
    : public tarn::kiln::MessageException<PropertyRelationValueNotPrimitive>
{
public:
    PropertyRelationValueNotPrimitive();
    ~PropertyRelationValueNotPrimitive() override;
};

/// Two properties of different types are compared.
class TARNKILN_EXPORT PropertyRelationPropertyTypeMismatch final
    : public tarn::kiln::MessageException<PropertyRelationPropertyTypeMismatch>
{
public:
    PropertyRelationPropertyTypeMismatch();
    ~PropertyRelationPropertyTypeMismatch() override;
};

/// The pattern of `like` is not exactly one value.
class TARNKILN_EXPORT LikePatternNotSingle final
    : public tarn::kiln::MessageException<LikePatternNotSingle>
{
public:
    LikePatternNotSingle();
    ~LikePatternNotSingle() override;
};

/// `like` is asked of a property that holds no text.
class TARNKILN_EXPORT LikePatternNotString final
    : public tarn::kiln::MessageException<LikePatternNotString>
{
public:
    LikePatternNotString();
    ~LikePatternNotString() override;
};

/// Values of a type can not be compared in that way.
class TARNKILN_EXPORT RelationAndTypeNotSupported final
    : public tarn::kiln::MessageException<RelationAndTypeNotSupported>
{
public:
    RelationAndTypeNotSupported(tarn::kiln::string const& relation,
                                tarn::kiln::ustring const& typeName);
    ~RelationAndTypeNotSupported() override;
};
}  // namespace tarnkiln::query
