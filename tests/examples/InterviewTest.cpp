#include "Interview.h"

#include "Figures.h"
#include "tests/examples/LoadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <stdexcept>

namespace {

using debian::Question;
using test::paragraph;
using testing::ElementsAre;
using testing::MatchesRegex;

using Kind = Question::Kind;

template <class Form> class InterviewTest : public testing::Test
{
protected:
    /// What an interview writes, the times left out.
    std::string answerTo(Question const& question, std::size_t maxRows = 0)
    {
        std::ostringstream output;
        debian::Interview<Form> interview(output, figures, index.loaded.index,
                                          debian::MissingNames(index.loaded.missing), maxRows);
        EXPECT_TRUE(interview.ask(question));

        std::istringstream lines(output.str());
        std::string result;
        for (std::string line; std::getline(lines, line);)
        {
            if (line.ends_with(" ms"))
                line.erase(line.rfind(" in "));
            result += line + '\n';
        }
        return result;
    }
    std::string figureTable() const
    {
        std::ostringstream output;
        figures.print(output);
        return output.str();
    }

    test::LoadedModel<Form> const index{
        paragraph("a", "Maintainer: Ann\nInstalled-Size: 5\nDepends: b, gone\nRecommends: lost\n") +
        paragraph("b", "Maintainer: Ann\nInstalled-Size: 10\n")};
    debian::Figures figures;
};
TYPED_TEST_SUITE(InterviewTest, test::BothForms, test::FormName);

TYPED_TEST(InterviewTest, ShowsEachAnswerUnderATitle)
{
    EXPECT_EQ(this->answerTo({Kind::Unmet, ""}), "\nUnmet dependencies\n"
                                                 "  package  release  unmet dependency\n"
                                                 "  -------  -------  ----------------\n"
                                                 "  a        1 all    Depends: gone\n"
                                                 "  1 row\n");
    EXPECT_EQ(this->answerTo({Kind::UnmetRecommended, ""}), "\nUnmet recommendations\n"
                                                            "  package  release  unmet dependency\n"
                                                            "  -------  -------  ----------------\n"
                                                            "  a        1 all    Recommends: lost\n"
                                                            "  1 row\n");
    EXPECT_EQ(this->answerTo({Kind::SameMaintainer, ""}),
              "\nPackages that depend on one of the same maintainer\n"
              "  package  depends on  maintainer\n"
              "  -------  ----------  ----------\n"
              "  a        b           Ann\n"
              "  1 row\n");
    EXPECT_EQ(this->answerTo({Kind::Largest, "."}), "\nThe largest packages that match \".\"\n"
                                                    "  package  release  KiB\n"
                                                    "  -------  -------  ---\n"
                                                    "  b        1 all     10\n"
                                                    "  a        1 all      5\n"
                                                    "  2 rows\n");
    EXPECT_EQ(this->answerTo({Kind::Reverse, "b"}), "\nDependencies on b\n"
                                                    "  package  release  dependency\n"
                                                    "  -------  -------  ----------\n"
                                                    "  a        1 all    Depends: b\n"
                                                    "  1 row\n");
}

TYPED_TEST(InterviewTest, TagsFindsAndTakesBack)
{
    EXPECT_EQ(this->answerTo({Kind::Tag, "^b$"}),
              "\nTagging as obsolete the packages that match \"^b$\": 1\n"
              "\nPackages with the tag\n"
              "  package  releases\n"
              "  -------  --------\n"
              "  b               1\n"
              "  1 row\n"
              "\nPackages with the tag after the rollback\n"
              "  0 rows\n");
}

TYPED_TEST(InterviewTest, CutsLongAnswers)
{
    EXPECT_EQ(this->answerTo({Kind::Largest, ""}, /*maxRows=*/1),
              "\nThe largest packages that match \"\"\n"
              "  package  release  KiB\n"
              "  -------  -------  ---\n"
              "  b        1 all     10\n"
              "  ... and 1 more\n"
              "  2 rows\n");
}

TYPED_TEST(InterviewTest, KeepsTheTimes)
{
    this->answerTo({Kind::SameMaintainer, ""});
    this->answerTo({Kind::Tag, "b"});

    EXPECT_THAT(this->figureTable(), MatchesRegex("  query: same maintainer     +[0-9.]+ ms\n"
                                                  "  query: tag                +[0-9.]+ ms\n"
                                                  "  query: tag after rollback +[0-9.]+ ms\n"));
}

TYPED_TEST(InterviewTest, LeavesNoTagWhenAPatternIsRefused)
{
    std::ostringstream output;
    debian::Interview<TypeParam> interview(output, this->figures, this->index.loaded.index, {}, 0);

    EXPECT_THROW(interview.ask({Kind::Tag, "(b"}), std::runtime_error);

    EXPECT_FALSE(
        this->index.model->getExtension(debian::Package<TypeParam>::metaClass(), u"isObsolete"));
    EXPECT_NE(this->answerTo({Kind::Tag, "b"}), "");
}

TYPED_TEST(InterviewTest, KnowsAQuestionOfEachKind)
{
    std::ostringstream output;
    debian::Interview<TypeParam> const interview(output, this->figures, this->index.loaded.index,
                                                 {}, 0);

    EXPECT_THAT(interview.usualQuestions(),
                ElementsAre(Question{Kind::Unmet, ""}, Question{Kind::UnmetRecommended, ""},
                            Question{Kind::SameMaintainer, ""}, Question{Kind::Largest, "^lib"},
                            Question{Kind::Reverse, "b"}, Question{Kind::Tag, "-dev$"}));
}

TYPED_TEST(InterviewTest, AsksForNoDependenciesWhereThereAreNone)
{
    test::LoadedModel<TypeParam> const lonely(paragraph("a"));
    std::ostringstream output;
    debian::Interview<TypeParam> const interview(output, this->figures, lonely.loaded.index, {}, 0);

    for (Question const& question : interview.usualQuestions())
        EXPECT_NE(question.kind, Kind::Reverse);
}

}  // namespace
