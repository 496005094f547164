/// \file
/// The classes of `Model`, `ModelElement` and `ModelConstellation`, which have no properties and
/// are there so that values can be typed by them.
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

namespace tarn::kiln {
namespace {

meta::Class modelClass;
meta::Class modelElementClass;
meta::Class modelConstellationClass;

/// Makes a class and enters it under its bare name. Stores it first, so that what the rest calls
/// may ask for it.
void createKernelClass(meta::MetaRegistry& registry, meta::Class& created, char const* uuid,
                       ustring const& name, string const& vobjName)
{
    {
        meta::MetaRegistry::LockedModel const locked(registry);
        created = meta::Class::create(locked.getModel(), boost::lexical_cast<UUID>(uuid));
    }
    created->setName(name);
    created->setVobjName(vobjName);
    registry.registerType(created, /*collection=*/nullptr, /*builder=*/nullptr);
}

/// `created`, with the registry started. While the registry starts it may still be empty.
meta::Class const& started(meta::Class const& created)
{
    meta::MetaRegistry::getInstance();
    return created;
}
}  // namespace

void Model::initializeType(meta::MetaRegistry& registry)
{
    createKernelClass(registry, modelClass, "a559b870-6892-3eec-8508-6ce5485e9784", u"Model",
                      "tarn.kiln.Model");
}

meta::Class const& Model::metaClass()
{
    return started(modelClass);
}

void ModelElement::initializeType(meta::MetaRegistry& registry)
{
    createKernelClass(registry, modelElementClass, "42663bf5-8b3d-3c82-938a-ed709e37a269",
                      u"ModelElement", "tarn.kiln.ModelElement");
}

meta::Class const& ModelElement::metaClass()
{
    return started(modelElementClass);
}

void ModelConstellation::initializeType(meta::MetaRegistry& registry)
{
    createKernelClass(registry, modelConstellationClass, "9dbcfe9e-bec1-3843-9db4-a894b2344149",
                      u"ModelConstellation", "tarn.kiln.ModelConstellation");
}

meta::Class const& ModelConstellation::metaClass()
{
    return started(modelConstellationClass);
}
}  // namespace tarn::kiln
