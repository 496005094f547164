// The example of the page on extensions.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/Extension.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace tarn::kiln {
namespace {

using meta::StandardTypes;

TEST(PageOnExtensions, ShowsWhatCanBeDone)
{
    meta::PackageDefinition definition(u"pageOnExtensions", u"http://example.org/extensions");
    meta::ClassDefinition defined = definition.defineClass(u"Book");
    definition.finish();
    meta::Class const book = defined;
    Model const library = Model::create(ModelConstellation());
    ModelElement const emma = ModelElement::createReflective(library, book);

#include "tests/meta/ExtensionPage.inc"

    EXPECT_EQ(emma->getModel(), archive);
    EXPECT_EQ(emma->getExtension(u"shelf").getValue<int>(), 3);
    std::vector<Value> const texts =
        emma->getExtension(u"notes").getValue<AbstractPrimitiveCollection&>().getAllValues();
    ASSERT_EQ(texts.size(), 1u);
    EXPECT_EQ(texts.front().getValue<ustring>(), u"a first edition");
    EXPECT_FALSE(library->getExtension(book, u"shelf"));
    archive->destroy();
}
}  // namespace
}  // namespace tarn::kiln
