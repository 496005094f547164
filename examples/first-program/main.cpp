#include "model/PackageImpl.h"
#include "model/PackageIndexImpl.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/Transaction.h"

#include <iostream>

using namespace debian::model;

struct Watcher : Listener
{
    void transactionCommitted(ReportData& report)
    {
        std::cout << "created " << report.getCreated().size() << " elements\n";
    }
};

int main()
{
    Model const model = Model::create(ModelConstellation());
    Watcher watcher;
    model->addListener(&watcher);

    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    PackageIndex const index = PackageIndex::create(model);
    Package const bash = Package::create(model);
    bash->setName(u"bash");
    bash->setIndex(index);  // index->getPackages() holds it now, under its name
    transaction.commit();   // the watcher is told

    {
        Transaction const dropped = model->beginTransaction(/*revertible=*/true);
        bash->destroy();
    }  // not committed, so taken back
    std::cout << (index->getPackages().find(u"bash") ? "bash is there\n" : "bash is gone\n");
    model->removeListener(&watcher);
}
