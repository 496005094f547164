#include "tarnkiln/meta/internal/CatalogueInvokers.h"

#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteral.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/InvokerImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"

#include <algorithm>
#include <iterator>
#include <string_view>

namespace tarn::kiln::internal {

using namespace meta;

namespace {

template <auto METHOD> std::unique_ptr<AbstractMethodInvoker> make()
{
    return makeInvoker(METHOD);
}

struct Row
{
    std::u16string_view className;
    std::u16string_view operation;
    std::unique_ptr<AbstractMethodInvoker> (*make)();
};

constexpr Row ROWS[] = {
    {u"Attribute", u"getType", &make<&Attribute::Impl::getType>},
    {u"AttributeMap", u"insert", &make<&AttributeMap::Impl::insert>},
    {u"AttributeMap", u"insertOrReplace", &make<&AttributeMap::Impl::insertOrReplace>},
    {u"AttributeMap", u"emplace", &make<&AttributeMap::Impl::emplace>},
    {u"AttributeMap", u"at", &make<&AttributeMap::Impl::at>},
    {u"AttributeMap", u"recursiveAt", &make<&AttributeMap::Impl::recursiveAt>},
    {u"AttributeMap", u"eraseValue", &make<&AttributeMap::Impl::eraseValue>},
    {u"AttributeMap", u"erase", &make<&AttributeMap::Impl::erase>},
    {u"AttributeMap", u"removeValue", &make<&AttributeMap::Impl::removeValue>},
    {u"AttributeMap", u"remove", &make<&AttributeMap::Impl::remove>},
    {u"AttributeMap", u"doRecurse", &make<&AttributeMap::Impl::doRecurse>},
    {u"Enum", u"findLiteralByValue", &make<&Enum::Impl::findLiteralByValue>},
    {u"Enum", u"findLiteralByPublicIdentifier", &make<&Enum::Impl::findLiteralByPublicIdentifier>},
    {u"Extension", u"createPrototype", &make<&Extension::Impl::createPrototype>},
    {u"StructuredType", u"getPropertyByName", &make<&StructuredType::Impl::getPropertyByName>},
    {u"StructuredType", u"getOperationsByName", &make<&StructuredType::Impl::getOperationsByName>},
    {u"StructuredType", u"isATypeOf", &make<&StructuredType::Impl::isATypeOf>},
    {u"Type", u"isA", &make<&Type::Impl::isA>},
};
}  // namespace

std::unique_ptr<AbstractMethodInvoker> makeCatalogueInvoker(ustring const& className,
                                                            ustring const& operationName)
{
    Row const* const row = std::ranges::find_if(ROWS, [&](Row const& candidate) {
        return candidate.className == className && candidate.operation == operationName;
    });
    return row == std::end(ROWS) ? nullptr : row->make();
}
}  // namespace tarn::kiln::internal
