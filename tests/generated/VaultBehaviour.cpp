#include "shapes/VaultImpl.h"

namespace testkit::shapes {

int Vault::Impl::score(int factor) const
{
    return 10 * factor;
}

void Vault::Impl::paint(Colour colour, Money const& price)
{
    Price changed = getPrice();
    Money net = price;
    net.setColour(colour);
    changed.setNet(net);
    setPrice(changed);
}

void Vault::Impl::doOpened()
{
    Price changed = getPrice();
    changed.setIsFinal(true);
    setPrice(changed);
}
}  // namespace testkit::shapes
