/// \file
/// How model ids are translated, and models loaded and saved by them.
#include "tarnkiln/services/ModelIdNormalizer.h"

#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/services/internal/AttachedService.h"
#include "tarnkiln/services/internal/ModelIdNormalizerTable.h"

#include <system_error>
#include <thread>

namespace tarn::kiln::services {
namespace {

using internal::AttachedService;
using internal::ModelIdNormalizerTable;

/// Answers for ids that begin with its scheme, and notes down what it is asked.
class SchemeNormalizer : public ModelIdNormalizer
{
public:
    SchemeNormalizer(ustring scheme, std::vector<std::string>& calls, std::string name = {})
        : m_scheme(std::move(scheme)),
          m_calls(calls),
          m_name(std::move(name))
    {}

    boost::optional<ustring> toLocationModelId(ustring const& id) override
    {
        m_calls.push_back("toLocation " + m_name);
        return answer(id, u"location:");
    }
    boost::optional<ustring> toExternalModelId(ustring const& id) override
    {
        m_calls.push_back("toExternal " + m_name);
        return answer(id, u"external:");
    }
    Model loadModel(ustring const& location) override
    {
        m_calls.push_back("load " + m_name);
        loadedLocation = location;
        return model;
    }
    bool saveModel(Model const& saved, ustring const& location) override
    {
        m_calls.push_back("save " + m_name);
        savedModel = saved;
        savedLocation = location;
        return saves;
    }

    Model model;  ///< What it loads.
    bool saves = false;
    ustring loadedLocation;
    Model savedModel;
    ustring savedLocation;

private:
    boost::optional<ustring> answer(ustring const& id, ustring const& prefix) const
    {
        return id.starts_with(m_scheme) ? boost::make_optional(prefix + id) : boost::none;
    }

    ustring m_scheme;
    std::vector<std::string>& m_calls;
    std::string m_name;
};

class ModelIds : public ::testing::Test
{
protected:
    using Attached = AttachedService<ModelIdNormalizer>;

    void SetUp() override { ModelIdNormalizerTable::getInstance().reset(); }
    void TearDown() override
    {
        m_attached.clear();
        ModelIdNormalizerTable::getInstance().reset();
    }

    std::shared_ptr<SchemeNormalizer> attach(ustring const& scheme, std::string const& name,
                                             std::optional<int> priority = {})
    {
        auto const normalizer = std::make_shared<SchemeNormalizer>(scheme, calls, name);
        attachAgain(normalizer, priority);
        return normalizer;
    }
    void attachAgain(std::shared_ptr<ModelIdNormalizer> const& normalizer,
                     std::optional<int> priority = {})
    {
        m_attached.push_back(std::make_unique<Attached>("(bundle.tarnkiln.modelIdNormalizer=*)",
                                                        normalizer, priority));
    }

    std::vector<std::string> calls;

private:
    std::vector<std::unique_ptr<Attached>> m_attached;
};

using Calls = std::vector<std::string>;

TEST_F(ModelIds, StayAsTheyAreWithoutNormalizers)
{
    EXPECT_EQ(ModelIdNormalizer::convertToLocationModelId(u"memory://3"), u"memory://3");
    EXPECT_EQ(ModelIdNormalizer::convertToExternalModelId(u"memory://3"), u"memory://3");
}

TEST_F(ModelIds, NameNothingWithoutNormalizers)
{
    EXPECT_EQ(ModelIdNormalizer::load(u"file:a"), Model());
    EXPECT_NO_THROW(ModelIdNormalizer::save(Model(), u"file:a"));
}

TEST_F(ModelIds, AreConvertedByTheFirstNormalizerThatKnowsThem)
{
    attach(u"file:", "file");
    attach(u"db:", "db");

    EXPECT_EQ(ModelIdNormalizer::convertToLocationModelId(u"file:a"), u"location:file:a");
    EXPECT_EQ(calls, (Calls{"toLocation db", "toLocation file"}));
    calls.clear();
    EXPECT_EQ(ModelIdNormalizer::convertToExternalModelId(u"db:a"), u"external:db:a");
    EXPECT_EQ(calls, (Calls{"toExternal db"}));
}

TEST_F(ModelIds, StayAsTheyAreIfNoNormalizerKnowsThem)
{
    attach(u"file:", "file");

    EXPECT_EQ(ModelIdNormalizer::convertToLocationModelId(u"x:a"), u"x:a");
    EXPECT_EQ(ModelIdNormalizer::convertToExternalModelId(u"x:a"), u"x:a");
}

TEST_F(ModelIds, GoToTheHighestPriorityFirst)
{
    attach(u"file:", "five", 5);
    attach(u"file:", "none");
    attach(u"file:", "minus one", -1);
    attach(u"file:", "seven", 7);

    ModelIdNormalizer::convertToLocationModelId(u"x:a");

    EXPECT_EQ(calls, (Calls{"toLocation seven", "toLocation five", "toLocation none",
                            "toLocation minus one"}));
}

TEST_F(ModelIds, GoToTheLastFoundFirstAmongEqualPriorities)
{
    attach(u"file:", "none");
    attach(u"file:", "zero", 0);
    attach(u"file:", "first of three", 3);
    attach(u"file:", "second of three", 3);

    ModelIdNormalizer::convertToExternalModelId(u"x:a");

    EXPECT_EQ(calls, (Calls{"toExternal second of three", "toExternal first of three",
                            "toExternal zero", "toExternal none"}));
}

TEST_F(ModelIds, GoOnceToANormalizerThatIsFoundTwice)
{
    auto const normalizer = attach(u"file:", "file", 4);
    attachAgain(normalizer, 9);

    ModelIdNormalizer::convertToLocationModelId(u"x:a");

    EXPECT_EQ(calls, (Calls{"toLocation file"}));
}

TEST_F(ModelIds, GoToNoNormalizerThatComesAfterTheFirstUse)
{
    ModelIdNormalizer::convertToLocationModelId(u"file:a");
    attach(u"file:", "late");

    EXPECT_EQ(ModelIdNormalizer::convertToLocationModelId(u"file:a"), u"file:a");
    EXPECT_TRUE(calls.empty());
}

TEST_F(ModelIds, LoadFromTheLocationThatAnotherNormalizerGives)
{
    auto const loader = attach(u"none:", "loader");
    auto const translator = attach(u"db:", "translator");
    loader->model = Model::createTransientModel();

    EXPECT_EQ(ModelIdNormalizer::load(u"db:a"), loader->model);

    EXPECT_EQ(calls, (Calls{"toLocation translator", "load translator", "load loader"}));
    EXPECT_EQ(loader->loadedLocation, u"location:db:a");
}

TEST_F(ModelIds, LoadByThemselvesWhereNoNormalizerTranslates)
{
    auto const loader = attach(u"none:", "loader");
    loader->model = Model::createTransientModel();

    EXPECT_EQ(ModelIdNormalizer::load(u"db:a"), loader->model);
    EXPECT_EQ(loader->loadedLocation, u"db:a");
}

TEST_F(ModelIds, LoadNoDeadModel)
{
    auto const second = attach(u"db:", "second");
    auto const first = attach(u"db:", "first");
    second->model = Model::createTransientModel();
    first->model = Model::createTransientModel();
    first->model->destroy();

    EXPECT_EQ(ModelIdNormalizer::load(u"db:a"), second->model);

    second->model->destroy();
    EXPECT_EQ(ModelIdNormalizer::load(u"db:a"), Model());
}

TEST_F(ModelIds, SaveByTheFirstNormalizerThatHandlesThem)
{
    auto const last = attach(u"db:", "last");
    auto const middle = attach(u"db:", "middle");
    auto const first = attach(u"db:", "first");
    last->saves = middle->saves = true;
    Model const model = Model::createTransientModel();
    ModelIdNormalizer::convertToLocationModelId(u"x:a");
    calls.clear();

    ModelIdNormalizer::save(model, u"db:a");

    EXPECT_EQ(calls, (Calls{"save first", "save middle"}));
    EXPECT_EQ(middle->savedModel, model);
    EXPECT_EQ(middle->savedLocation, u"db:a");
}

TEST_F(ModelIds, SaveThroughNoNormalizerBeforeAnythingElseWasAsked)
{
    attach(u"db:", "db")->saves = true;

    ModelIdNormalizer::save(Model(), u"db:a");
    EXPECT_TRUE(calls.empty());

    ModelIdNormalizer::load(u"x:a");
    calls.clear();
    ModelIdNormalizer::save(Model(), u"db:a");
    EXPECT_EQ(calls, (Calls{"save db"}));
}

/// Breaks at the named operation.
class FailingNormalizer : public SchemeNormalizer
{
public:
    using SchemeNormalizer::SchemeNormalizer;

    Model loadModel(ustring const&) override { throw std::runtime_error("no such file"); }
    bool saveModel(Model const&, ustring const&) override { throw std::runtime_error("disk full"); }
};

TEST_F(ModelIds, PassTheFailuresOfNormalizersOn)
{
    attachAgain(std::make_shared<FailingNormalizer>(u"db:", calls));

    EXPECT_THROW(ModelIdNormalizer::load(u"db:a"), std::runtime_error);
    EXPECT_THROW(ModelIdNormalizer::save(Model(), u"db:a"), std::runtime_error);
}
}  // namespace
}  // namespace tarn::kiln::services
