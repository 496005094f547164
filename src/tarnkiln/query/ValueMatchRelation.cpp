#include "tarnkiln/query/ValueMatchRelation.h"

namespace tarn::kiln::query {

string ValueMatchRelationName(ValueMatchRelation relation)
{
    switch (relation)
    {
    case ValueMatchRelation::equal:
        return "equal";
    case ValueMatchRelation::equalStringNocase:
        return "equalStringNocase";
    case ValueMatchRelation::notEqual:
        return "notEqual";
    case ValueMatchRelation::greater:
        return "greater";
    case ValueMatchRelation::greaterOrEqual:
        return "greaterOrEqual";
    case ValueMatchRelation::less:
        return "less";
    case ValueMatchRelation::lessOrEqual:
        return "lessOrEqual";
    case ValueMatchRelation::like:
        return "like";
    case ValueMatchRelation::regexp:
        return "regexp";
    }
    return string();
}
}  // namespace tarn::kiln::query
