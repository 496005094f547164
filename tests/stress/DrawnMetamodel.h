/// \file
/// Metamodels that are drawn at random, and what edits of their elements ought to do.
#pragma once
#include <cstddef>
#include <map>
#include <random>
#include <string>
#include <vector>

namespace testkit {

/// Classes and properties by number, each class with all that its superclasses have.
struct DrawnMetamodel
{
    static constexpr int NONE = -1;

    struct Property
    {
        int owner = 0;
        int target = NONE;  ///< A class, or none for an attribute that holds a number.
        bool many = false;
        bool ordered = false;
        bool unique = false;
        bool composite = false;
        int opposite = NONE;
    };

    /// Up to five classes, each below an earlier one or none, and up to twelve properties: of
    /// attributes, references and contents each kind, with and without opposite.
    static DrawnMetamodel draw(std::mt19937& random);

    bool isA(int subclass, int superclass) const;
    bool isAttribute(int property) const { return at(property).target == NONE; }
    Property const& at(int property) const
    {
        return properties[static_cast<std::size_t>(property)];
    }

    std::vector<int> superclasses;  ///< Of each class; a lower number.
    std::vector<Property> properties;

private:
    int add(Property const& property);
    void addAssociation(Property end, Property otherEnd);
};

/// Plays elements of a drawn metamodel, under the numbers of their creation.
///
/// Copied to be restored at a rollback.
class ElementMirror
{
public:
    static constexpr int NONE = DrawnMetamodel::NONE;

    struct Element
    {
        int metaClass = 0;
        int container = NONE;
        int place = NONE;  ///< The property of the container.
        /// Numbers of an attribute, elements of a reference. Dead ones stay where no opposite
        /// tells that they go.
        std::map<int, std::vector<int>> values;
    };

    /// \param metamodel  must outlive the mirror.
    explicit ElementMirror(DrawnMetamodel const& metamodel) : m_metamodel(&metamodel) {}

    std::map<int, Element> const& elements() const { return m_elements; }
    std::vector<int> valuesOf(int element, int property) const;
    int classOf(int element) const { return m_elements.at(element).metaClass; }

    void create(int element, int metaClass) { m_elements[element].metaClass = metaClass; }
    void destroy(int element);

    /// \name Attributes
    /// @{
    void setNumber(int element, int property, int number);
    void addNumber(int element, int property, int number);
    /// @}

    /// \name References; false if the element would contain itself
    /// @{
    bool set(int element, int property, int target);  ///< Of a single one, also to none.
    bool add(int element, int property, int target);
    void remove(int element, int property, int target);
    /// @}

private:
    bool isAlive(int element) const { return m_elements.count(element) != 0; }
    bool isInside(int element, int outer) const;
    bool holds(int element, int property, int target) const;
    void link(int element, int property, int target);
    void unlink(int element, int property, int target);
    void leaveContainer(int element);
    void forget(int element);

    DrawnMetamodel const* m_metamodel;
    std::map<int, Element> m_elements;
};
}  // namespace testkit
