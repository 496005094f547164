// A program of somebody who has nothing but the installed package.
#include "shop/ShopImpl.h"
#include "shop/WareImpl.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"

#include <iostream>

namespace messages = tarnkiln::messages;

/// Whether the classes of shop.json keep what is put into them.
bool usesItsMetamodel()
{
    tarn::kiln::Model const model = tarn::kiln::Model::create(tarn::kiln::ModelConstellation());
    shop::Shop const shop = shop::Shop::create(model);
    shop::Ware const ware = shop::Ware::create(model);
    ware->setName(u"tea");
    ware->setShop(shop);
    return shop->getWares().find(u"tea") == ware && ware->getMetaClass() == shop::Ware::metaClass();
}

int main()
{
    if (!usesItsMetamodel())
        return 1;
    try
    {
        tarn::kiln::reportException(messages::NoSuchType(u"Book"));
    }
    catch (messages::NoSuchType const& failure)
    {
        std::cout << "caught: " << failure.what() << '\n';
        return failure.getArguments().size() == 1 ? 0 : 1;
    }
}
