#include "reader/Paragraph.h"

#include "reader/Ascii.h"

namespace debian {

std::string_view Paragraph::nameOf(Place const& place) const
{
    return std::string_view(m_text).substr(place.nameBegin, place.valueBegin - place.nameBegin);
}

Paragraph::Field Paragraph::fieldAt(std::size_t index) const
{
    Place const& place = m_fields[index];
    std::string_view const text = m_text;
    return {nameOf(place), text.substr(place.valueBegin, place.valueEnd - place.valueBegin),
            place.line};
}

std::optional<Paragraph::Field> Paragraph::find(std::string_view name) const
{
    for (std::size_t i = 0; i < m_fields.size(); ++i)
    {
        if (ascii::equalsIgnoringCase(nameOf(m_fields[i]), name))
            return fieldAt(i);
    }
    return std::nullopt;
}

void Paragraph::clear()
{
    m_text.clear();
    m_fields.clear();
}

void Paragraph::addField(std::string_view name, std::string_view value, std::size_t line)
{
    std::size_t const nameBegin = m_text.size();
    m_text.append(name);
    std::size_t const valueBegin = m_text.size();
    m_text.append(value);
    m_fields.push_back({nameBegin, valueBegin, m_text.size(), line});
}

void Paragraph::continueField(std::string_view line)
{
    m_text.push_back('\n');
    m_text.append(line);
    m_fields.back().valueEnd = m_text.size();
}

}  // namespace debian
