#include "ModelSnapshot.h"

#include "OldValues.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include "sill/i18n/StringConversion.h"

#include <boost/optional.hpp>
#include <boost/uuid/name_generator_sha1.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <algorithm>
#include <map>
#include <stdexcept>

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_string;

namespace {

std::string plainText(Value const& value, meta::Type const& type)
{
    if (type == meta::StandardTypes::stringMeta)
        return to_string(value.getValue<ustring>());
    if (type == meta::StandardTypes::booleanMeta)
        return value.getValue<bool>() ? "true" : "false";
    if (type == meta::StandardTypes::integer64Meta)
    {
        auto const number = value.getValue<boost::optional<long>>();
        return number ? std::to_string(*number) : std::string("none");
    }
    throw std::logic_error("snapshots do not know the type " + to_string(type->getName()));
}

/// The UUID that a reference stands for, marked if its element is dead.
std::string targetText(ModelElement const& target)
{
    if (!target)
        return "destroyed " + boost::uuids::to_string(target->getUuid());
    if (auto const id = target->getProxyId())
        return to_string(id->getId());
    return boost::uuids::to_string(target->getUuid());
}

/// Writes the texts that a digest is made of, each with its length.
class Encoder
{
public:
    std::string const& encode(ModelElement const& element)
    {
        m_text.clear();
        meta::Class const metaClass = element->getMetaClass();
        add(to_string(metaClass->getName()));
        if (ModelElement const container = element->container())
        {
            add(boost::uuids::to_string(container->getUuid()));
            add(to_string(element->containmentFeature()->getName()));
        }
        for (meta::Property const& property : plainPropertiesOf(metaClass))
        {
            Value const value =
                element->getPropertyValue(property, ModelElement::Impl::NO_PROXY_RESOLVE);
            add(to_string(property->getName()));
            add(plainText(value, property->getType()));
        }
        for (auto const& [name, targets] : targetsByName(element))
        {
            add(to_string(name));
            for (std::string const& target : targets)
                add(target);
        }
        return m_text;
    }

private:
    /// Metamodels may have their properties in different orders.
    static std::map<ustring, std::vector<std::string>> targetsByName(ModelElement const& element)
    {
        std::map<ustring, std::vector<std::string>> result;
        element->visitReferences([&](ModelElement const& target, Feature const& feature) {
            result[feature.property()->getName()].push_back(targetText(target));
        });
        return result;
    }

    void add(std::string const& text)
    {
        m_text.append(std::to_string(text.size())).append(1, ':').append(text);
    }

    std::vector<meta::Property> const& plainPropertiesOf(meta::Class const& metaClass)
    {
        auto const [place, isNew] = m_plainProperties.try_emplace(metaClass);
        if (isNew)
        {
            place->second = propertiesOf(metaClass);
            std::erase_if(place->second, isReference);
        }
        return place->second;
    }

    std::string m_text;
    std::map<meta::Class, std::vector<meta::Property>> m_plainProperties;
};

}  // namespace

ModelSnapshot::ModelSnapshot(Model const& model)
{
    boost::uuids::name_generator_sha1 const digestOf{UUID{}};
    Encoder encoder;
    m_digests.reserve(model->getElementCount());
    for (ModelElement const& element : model->getAllElements())
        m_digests.emplace_back(element->getUuid(), digestOf(encoder.encode(element)));
    std::sort(m_digests.begin(), m_digests.end());
}

std::string ModelSnapshot::fingerprint() const
{
    std::string text;
    for (auto const& [id, digest] : m_digests)
        text += boost::uuids::to_string(id) + boost::uuids::to_string(digest);
    return boost::uuids::to_string(boost::uuids::name_generator_sha1(UUID{})(text));
}

std::vector<std::string> ModelSnapshot::differences(ModelSnapshot const& later,
                                                    std::size_t maxLines) const
{
    std::vector<std::string> lines;
    auto const add = [&](UUID const& id, char const* what) {
        lines.push_back(boost::uuids::to_string(id) + what);
    };
    auto before = m_digests.begin();
    auto after = later.m_digests.begin();
    while (lines.size() < maxLines && (before != m_digests.end() || after != later.m_digests.end()))
    {
        bool const onlyBefore = after == later.m_digests.end() ||
                                (before != m_digests.end() && before->first < after->first);
        bool const onlyAfter =
            before == m_digests.end() || (!onlyBefore && after->first < before->first);
        if (onlyBefore)
            add(before->first, " is missing");
        else if (onlyAfter)
            add(after->first, " is new");
        else if (before->second != after->second)
            add(before->first, " differs");
        before += onlyAfter ? 0 : 1;
        after += onlyBefore ? 0 : 1;
    }
    return lines;
}

}  // namespace debian
