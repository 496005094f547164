#include "shapes/GongImpl.h"

#include "shapes/Node.h"

namespace testkit::shapes {

void Gong::Impl::doRung(int times, Node const& by, std::vector<ustring> const& words, Colour colour,
                        boost::optional<ustring> const& note, bool isLoud)
{
    Bell::Impl::doRung(10 * times, by, words, colour, note, isLoud);
}
}  // namespace testkit::shapes
