/// \file
/// Puts questions to an index and shows the answers.
#pragma once
#include "Forms.h"
#include "Question.h"
#include "Questions.h"

#include <cstddef>
#include <functional>
#include <iosfwd>
#include <string>
#include <vector>

namespace debian {
class Figures;

/// Writes each answer as a table under a title, and keeps the times that the answers took.
///
/// Threads: as the model of the index.
template <ElementForm Form> class Interview
{
public:
    /// \param output, figures  must outlive the object.
    /// \param maxRows  of one table; 0 for all.
    Interview(std::ostream& output, Figures& figures, PackageIndex<Form> const& index,
              MissingNames missing, std::size_t maxRows);

    /// \throws std::runtime_error  if a pattern is no regular expression, or a name unknown. The
    ///     model is as it was.
    /// \returns false if a tag was still found after the rollback.
    bool ask(Question const& question);
    /// One question of each kind, for who asks for nothing in particular. The one for dependencies
    /// on a package is about the one that most of them name, if there is any.
    std::vector<Question> usualQuestions() const;

private:
    /// \returns the number of rows.
    std::size_t show(std::string const& title, std::string const& figure,
                     std::function<Table()> const& answer);
    bool tag(std::string const& pattern);

    std::ostream& m_output;
    Figures& m_figures;
    PackageIndex<Form> m_index;
    Questions<Form> m_questions;
    std::size_t m_maxRows;
};

}  // namespace debian
