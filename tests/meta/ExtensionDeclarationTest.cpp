#include "tarnkiln/meta/ExtensionImpl.h"
#include "tests/meta/MetamodelSketch.h"

namespace tarn::kiln::meta {

using PrototypeOfAnExtension = MetamodelSketch;

TEST_F(PrototypeOfAnExtension, HasItsDescription)
{
    Extension const extension = named<Extension>(u"shelf");
    extension->setType(cls(u"Shelf", {}, package(u"library")));
    extension->setLower(1);
    extension->setUpper(1);
    extension->setIsUnique(true);

    ExtensionPrototype const prototype = extension->createPrototype();

    EXPECT_EQ(prototype.getName(), u"shelf");
    EXPECT_EQ(prototype.getTypeName(), u"library.Shelf");
    EXPECT_EQ(prototype.getLower(), 1u);
    EXPECT_EQ(prototype.getUpper(), 1u);
    EXPECT_FALSE(prototype.isOrdered());
    EXPECT_TRUE(prototype.isUnique());
}

TEST_F(PrototypeOfAnExtension, KnowsNoUpperBoundAboveOne)
{
    Extension const extension = Extension::create(m_model);
    extension->setUpper(5);

    EXPECT_EQ(extension->createPrototype().getUpper(), 0xFFFFFFFFu);
}
}  // namespace tarn::kiln::meta
