#include "tarnkiln/query/Messages.h"

namespace tarnkiln::query {
namespace {

bedrock::core::except::MsgIDObj messageId(char const* name)
{
    return {name, "tarnkiln:query"};
}
}  // namespace

InvalidSearchClass::InvalidSearchClass()
    : Exception(messageId("InvalidSearchClass"), {},
                "the class to search is empty or was destroyed")
{}

InvalidSearchClass::~InvalidSearchClass() = default;

NoSuchInstanceId::NoSuchInstanceId()
    : Exception(messageId("NoSuchInstanceId"), {},
                "the query has no search instance of that number")
{}

NoSuchInstanceId::~NoSuchInstanceId() = default;

NoSearchInstances::NoSearchInstances()
    : Exception(messageId("NoSearchInstances"), {}, "the query searches no class")
{}

NoSearchInstances::~NoSearchInstances() = default;

NoModel::NoModel() : Exception(messageId("NoModel"), {}, "the query has no model to search") {}

NoModel::~NoModel() = default;

PropertyRelationValueNotPrimitive::PropertyRelationValueNotPrimitive()
    : Exception(messageId("PropertyRelationValueNotPrimitive"), {},
                "a query compares single values only, and this is a collection")
{}

PropertyRelationValueNotPrimitive::~PropertyRelationValueNotPrimitive() = default;

PropertyRelationPropertyTypeMismatch::PropertyRelationPropertyTypeMismatch()
    : Exception(messageId("PropertyRelationPropertyTypeMismatch"), {},
                "the properties that are compared have different types")
{}

PropertyRelationPropertyTypeMismatch::~PropertyRelationPropertyTypeMismatch() = default;

LikePatternNotSingle::LikePatternNotSingle()
    : Exception(messageId("LikePatternNotSingle"), {}, "a like pattern must be exactly one value")
{}

LikePatternNotSingle::~LikePatternNotSingle() = default;

LikePatternNotString::LikePatternNotString()
    : Exception(messageId("LikePatternNotString"), {},
                "only properties of the types String and StdString have like patterns")
{}

LikePatternNotString::~LikePatternNotString() = default;

RelationAndTypeNotSupported::RelationAndTypeNotSupported(tarn::kiln::string const& relation,
                                                         tarn::kiln::ustring const& typeName)
    : Exception(messageId("RelationAndTypeNotSupported"), {relation, typeName},
                "the relation '{0}' does not exist for this property of type '{1}'")
{}

RelationAndTypeNotSupported::~RelationAndTypeNotSupported() = default;
}  // namespace tarnkiln::query
