#include "shapes/BellImpl.h"

#include "shapes/Colour.h"
#include "shapes/NodeImpl.h"

namespace testkit::shapes {

void Bell::Impl::doRung(int times, Node const& by, std::vector<ustring> const& words, Colour colour,
                        boost::optional<ustring> const& note, bool isLoud)
{
    setStrokes(getStrokes() + times);
    if (by)
        getLog().push_back(by->getName());
    for (ustring const& word : words)
        getLog().push_back(word);
    if (note)
        getLog().push_back(*note);
    getLog().push_back(colour == Colour::Red && isLoud ? u"red and loud" : u"anything else");
}

void Bell::Impl::doHung()
{
    getLog().push_back(u"hung");
}

void Bell::Impl::doMet(std::vector<Bell> const& bells)
{
    for (Bell const& bell : bells)
        setStrokes(getStrokes() + bell->getStrokes());
}
}  // namespace testkit::shapes
