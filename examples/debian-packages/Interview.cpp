#include "Interview.h"

#include "Figures.h"
#include "ObsoleteTag.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"

#include <ostream>
#include <utility>

namespace debian {

using namespace tarn::kiln;

template <ElementForm Form>
Interview<Form>::Interview(std::ostream& output, Figures& figures, PackageIndex<Form> const& index,
                           MissingNames missing, std::size_t maxRows)
    : m_output(output),
      m_figures(figures),
      m_index(index),
      m_questions(index, std::move(missing)),
      m_maxRows(maxRows)
{}

template <ElementForm Form> bool Interview<Form>::ask(Question const& question)
{
    std::string const& argument = question.argument;
    switch (question.kind)
    {
    case Question::Kind::Unmet:
        show("Unmet dependencies", "unmet dependencies",
             [&] { return m_questions.unmetDependencies(STRICT_KINDS); });
        break;
    case Question::Kind::UnmetRecommended:
        show("Unmet recommendations", "unmet recommendations",
             [&] { return m_questions.unmetDependencies(RECOMMENDED_KIND); });
        break;
    case Question::Kind::SameMaintainer:
        show("Packages that depend on one of the same maintainer", "same maintainer",
             [&] { return m_questions.dependenciesOfSameMaintainer(); });
        break;
    case Question::Kind::Largest:
        show("The largest packages that match \"" + argument + '"', "largest packages",
             [&] { return m_questions.largestPackages(argument); });
        break;
    case Question::Kind::Reverse:
        show("Dependencies on " + argument, "reverse dependencies",
             [&] { return m_questions.reverseDependencies(argument); });
        break;
    case Question::Kind::Tag:
        return tag(argument);
    }
    return true;
}

template <ElementForm Form>
std::size_t Interview<Form>::show(std::string const& title, std::string const& figure,
                                  std::function<Table()> const& answer)
{
    Stopwatch const stopwatch;
    Table const table = answer();
    auto const time = stopwatch.elapsed();
    m_figures.addTime("query: " + figure, time);
    m_output << '\n' << title << '\n';
    table.print(m_output, m_maxRows, time);
    return table.rows().size();
}

template <ElementForm Form> bool Interview<Form>::tag(std::string const& pattern)
{
    ObsoleteTag<Form> const obsolete(m_index->getModel());
    auto const packages = [&] { return obsolete.packagesWithTag(); };

    Transaction const transaction = m_index->getModel()->beginTransaction(/*revertible=*/true);
    std::size_t const count = obsolete.setOnMatching(pattern);
    m_output << "\nTagging as obsolete the packages that match \"" << pattern << "\": " << count
             << '\n';
    show("Packages with the tag", "tag", packages);
    transaction.rollBack();
    return show("Packages with the tag after the rollback", "tag after rollback", packages) == 0;
}

template <ElementForm Form> std::vector<Question> Interview<Form>::usualQuestions() const
{
    std::vector<Question> questions = {{Question::Kind::Unmet, ""},
                                       {Question::Kind::UnmetRecommended, ""},
                                       {Question::Kind::SameMaintainer, ""},
                                       {Question::Kind::Largest, "^lib"}};
    if (std::string const name = m_questions.mostNamedPackage(); !name.empty())
        questions.push_back({Question::Kind::Reverse, name});
    questions.push_back({Question::Kind::Tag, "-dev$"});
    return questions;
}

#define DEBIAN_INSTANTIATE(Form) template class Interview<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
