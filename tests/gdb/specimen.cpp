/// \file
/// A program whose variables are looked at in gdb, where `stop` is called.
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/NodeImpl.h"

using namespace tarn::kiln;
using testkit::Node;

/// Where gdb looks; the call keeps the handles alive.
__attribute__((noinline)) void stop(Node const& node)
{
    asm volatile("" : : "r"(&node) : "memory");
}

int main()
{
    UUID const id{{0xaa, 0, 0, 0, 0, 1, 0x42, 2, 0x83, 3, 0, 0, 0, 0, 0, 4}};
    Model const model = Model::create(ModelConstellation());
    Node const node = Node::create(model, id);
    Node const child = Node::create(model);
    Node const gone = Node::create(model);
    Node const empty;
    node->setName(u"alpha \u00e9");
    child->setName(u"beta");
    node->getChildren().push_back(child);
    node->getNumbers().push_back(3);
    node->getNumbers().push_back(5);
    node->setBuddy(child);
    gone->destroy();
    ustring const text = u"a text";
    Value const number(meta::StandardTypes::integerMeta, 42);
    Value const title(meta::StandardTypes::stringMeta, text);
    Value const absent(meta::StandardTypes::integerMeta, boost::optional<int>());
    auto const& children = node->getChildren();
    auto const& numbers = node->getNumbers();
    stop(node);
    return children.size() == 1 && numbers.size() == 2 ? 0 : 1;
}
