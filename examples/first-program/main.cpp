#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Text.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <iostream>

using namespace tarn::kiln;
using meta::StandardTypes;

struct Watcher : Listener
{
    void transactionCommitted(ReportData& report)
    {
        std::cout << "created " << report.getCreated().size() << " elements\n";
    }
};

int main()
{
    meta::PackageDefinition library(u"library", u"http://example.org/library");
    meta::ClassDefinition book = library.defineClass(u"Book");
    meta::Property const title = book.attribute(u"title", StandardTypes::stringMeta);
    library.finish();

    Model const model = Model::create(ModelConstellation());
    Watcher watcher;
    model->addListener(&watcher);

    auto const& access = ModelElement::Impl::PUBLIC_ACCESS;
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    ModelElement const emma = ModelElement::createReflective(model, book);
    emma->setPropertyValue(title, Value(StandardTypes::stringMeta, ustring(u"Emma")), access);
    transaction.commit();  // the watcher is told

    {
        Transaction const dropped = model->beginTransaction(/*revertible=*/true);
        emma->destroy();
    }  // not committed, so taken back
    std::cout << (emma ? toUtf8(emma->getPropertyValue(title, access).getValue<ustring>())
                       : "nothing")
              << " is there\n";
    model->removeListener(&watcher);
}
