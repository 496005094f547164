/// \file
/// A model and a builder of nodes in it, for the tests of what builders do.
#pragma once
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/DataModelUsageProvider.h"
#include "tarnkiln/meta/Package.h"
#include "tests/support/NodeBuilder.h"
#include "tests/support/NodeMetamodel.h"

#include <gmock/gmock.h>

#include <functional>
#include <memory>
#include <utility>
#include <vector>

namespace testkit {

class NodeBuilding : public ::testing::Test
{
protected:
    ~NodeBuilding() override
    {
        EXPECT_THAT(m_model->checkInvariants(), ::testing::IsEmpty());
        EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
    }

    static meta::Property const& property(Slot const& slot)
    {
        return NodeMetamodel::get().properties[slot.index];
    }
    template <class T> static Value plain(Slot const& slot, T const& value)
    {
        return Value::createPrimitiveValue(property(slot), value);
    }
    static Value element(Slot const& slot, Node const& node)
    {
        return Value::createElementValue(property(slot), node);
    }
    static std::unique_ptr<Node::Builder> named(ustring const& name)
    {
        auto builder = std::make_unique<Node::Builder>();
        builder->setName(name);
        return builder;
    }
    Node make(ustring const& name = {})
    {
        Node const node = Node::create(m_model);
        node->setName(name);
        return node;
    }
    Node build(ModelElement::Builder& builder) { return Node::cast(builder.create()); }
    static std::vector<ustring> names(ReferenceCollection const& collection)
    {
        std::vector<ustring> result;
        for (ModelElement const& member : collection.getAllValues())
            result.push_back(Node::cast(member)->getName());
        return result;
    }

    /// Calls `seen` for each node that the model gets from now on, before it is in a container.
    void whenAnnounced(std::function<void(Node const&)> seen)
    {
        m_model->setUsageProvider(std::make_unique<Announcements>(std::move(seen)));
    }

    Model const m_model = Model::create(ModelConstellation());
    Node::Builder m_builder{m_model};

private:
    class Announcements : public meta::DataModelUsageProvider
    {
    public:
        explicit Announcements(std::function<void(Node const&)> seen) : m_seen(std::move(seen)) {}

        std::vector<meta::Package> getUsedPackages() const override { return {}; }
        void elementCreated(ModelElement::Impl* element) override
        {
            m_seen(Node::cast(ModelElement(element)));
        }

    private:
        std::function<void(Node const&)> m_seen;
    };
};
}  // namespace testkit
