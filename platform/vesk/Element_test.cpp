// The element tree itself: values, copies, moves, lookups, equality and their exceptions.
#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "Vesk/Element.h"
#include "XmlTestSupport.h"

namespace Vesk {
namespace {

using Testing::textElement;

// Root "Root" with children Tag="a", Tag="b", Value (no value) and a list holding nested lists.
Element sampleTree(const char* nested = "y") {
    Element root("Root");
    root.insertAttributes({{"version", "2"}, {"kind", "sample"}});
    MultiElementValue& children = root.addMultiElement();
    children.addElement(textElement("Tag", "a"));
    children.addElement(textElement("Tag", "b"));
    children.addElement("Value", Attributes(), -1);
    MultiValue& list = children.addElement(new Element("List")).addMulti();
    list.addSingle().assign("x");
    list.addMulti().addSingle().assign(nested);
    list.addMultiElement().addElement(textElement("Inner", "z"));
    return root;
}

std::string textOf(const Element& element) {
    return element.getSingle().value().c_str();
}

// What call throws: "NoValueSetEx: <message>", "TrelException: <message>" or "nothing".
template <class Call>
std::string thrown(Call call) {
    try {
        call();
    } catch (const Element::NoValueSetEx& e) {
        return std::string("NoValueSetEx: ") + e.what();
    } catch (const TrelException& e) {
        return std::string("TrelException: ") + e.what();
    }
    return "nothing";
}

// Guards the distinction readers rely on: no value is NoValueSetEx, another kind is not.
TEST(VeskElement, MissingValueAndValueOfAnotherKindThrowDifferentlyNamingTheKey) {
    Element element("Tag");
    const Element& constant = element;
    EXPECT_THROW(constant.getMultiElement(), Element::NoValueSetEx);
    EXPECT_THROW(constant.value(), Element::NoValueSetEx);
    EXPECT_EQ("NoValueSetEx: Vesk::Element::getSingle: element 'Tag' has no value",
              thrown([&] { element.getSingle(); }));
    element.addMulti();
    EXPECT_NO_THROW(constant.getMulti());
    EXPECT_EQ(
        "TrelException: Vesk::Element::getSingle: element 'Tag' holds a multi value, not a single "
        "value",
        thrown([&] { constant.getSingle(); }));
}

TEST(VeskElement, AddReplacesTheValueAndSetValueNullRemovesIt) {
    Element element("Key");
    element.addSingle().assign("one");
    element.addMultiElement();
    EXPECT_EQ(0u, element.getMultiElement().size());
    element.setValue(std::make_unique<SingleValue>(ACE_CString("two")));
    EXPECT_EQ("two", textOf(element));
    element.setValue(nullptr);
    EXPECT_FALSE(element.hasValue());
}

TEST(VeskElement, AttributesKeepOrderAndDuplicatesAndTheFirstWins) {
    Element element("Key");
    element.insertAttributes({{"a", "1"}, {"b", "2"}});
    element.insertAttributes({{"a", "3"}});
    EXPECT_EQ((Attributes{{"a", "1"}, {"b", "2"}, {"a", "3"}}), element.attributes());
    bool found = false;
    EXPECT_STREQ("1", element.getAttributeValue("a", found).c_str());
    EXPECT_TRUE(found);
    EXPECT_TRUE(element.getAttributeValue("c", found).empty());
    EXPECT_FALSE(found);
}

TEST(VeskElement, CopiesAreDeepAndMovesLeaveAnEmptyElement) {
    const std::string longText(1000, 't');  // keys and texts beyond the inline size
    for (const Element& original :
         {sampleTree(), textElement(longText.substr(0, 100).c_str(), longText.c_str())}) {
        Element copy(original);
        EXPECT_EQ(original, copy);
        copy = original;
        copy = copy;  // self-assignment keeps the tree
        EXPECT_EQ(original, copy);
        Element moved(std::move(copy));
        EXPECT_EQ(original, moved);
        EXPECT_FALSE(copy.hasValue());
        EXPECT_TRUE(copy.key().empty());
        Element target = textElement("Old", "old");
        target = std::move(moved);
        EXPECT_EQ(original, target);
        EXPECT_FALSE(moved.hasValue());
        EXPECT_TRUE(moved.attributes().empty());
    }
    const Element original = sampleTree();
    Element copy(original);
    copy.getMultiElement().getElement("Tag").getSingle().assign("changed");
    EXPECT_EQ(sampleTree(), original);  // the copy shares no node with the original
    EXPECT_NE(original, copy);
}

TEST(VeskElement, ChildrenAndGivenValuesStayWhereTheyAreWhenTheElementMoves) {
    Element list("List");
    MultiElementValue& children = list.addMultiElement();
    Element& first = children.addElement(textElement("First", "1"));
    for (int i = 0; i < 100; ++i) {
        children.addElement(textElement("Sibling", "s"));  // the children's vector grows meanwhile
    }
    Element movedList(std::move(list));
    EXPECT_EQ(&first, &movedList.getMultiElement().getElement("First"));
    EXPECT_EQ("1", textOf(first));

    auto given = std::make_unique<SingleValue>(ACE_CString("given"));
    const SingleValue* address = given.get();
    Element holder("Holder");
    holder.setValue(std::move(given));
    Element movedHolder(std::move(holder));
    EXPECT_EQ(address, &movedHolder.getSingle());
    const Element copy(movedHolder);
    EXPECT_NE(address, &copy.getSingle());
    EXPECT_EQ(movedHolder, copy);
}

// Guards against reading the source after freeing it: it may sit inside the target's value.
TEST(VeskElement, AssigningAnElementFromItsOwnDescendant) {
    Element root = sampleTree();
    root = std::move(root.getMultiElement().getElement("List"));
    EXPECT_EQ("List", std::string(root.key().c_str()));
    EXPECT_EQ(3u, root.getMulti().size());

    Element other = sampleTree();
    other = other.getMultiElement().getElement("Tag");
    EXPECT_EQ(textElement("Tag", "a"), other);
}

TEST(VeskElement, EqualityComparesKeyAttributesAndValuesDeeply) {
    const Element base = sampleTree();
    Element differentKey = sampleTree();
    differentKey.setKey("root");
    EXPECT_NE(base, differentKey);
    Element differentAttributeOrder("Root");
    differentAttributeOrder.insertAttributes({{"kind", "sample"}, {"version", "2"}});
    differentAttributeOrder.setValue(base.value().clone());
    EXPECT_NE(base, differentAttributeOrder);
    EXPECT_NE(base, sampleTree("Y"));               // a text deep in a list of lists
    EXPECT_EQ(Element("K", 7), Element("K", -1));   // the id is not part of the contents
    EXPECT_NE(Element("K"), textElement("K", ""));  // no value differs from an empty text
    Element emptyMulti("K");
    emptyMulti.addMulti();
    Element emptyList("K");
    emptyList.addMultiElement();
    EXPECT_NE(emptyMulti, emptyList);  // kinds differ even when both are empty
}

TEST(VeskMultiElementValue, LookupsFindTheFirstChildWithExactlyThatKey) {
    Element root = sampleTree();
    const MultiElementValue& children = root.getMultiElement();
    EXPECT_EQ("a", textOf(children.getElement("Tag")));
    EXPECT_TRUE(children.has("Value"));
    EXPECT_FALSE(children.has("tag"));
    EXPECT_EQ(nullptr, children.find("Missing"));
    EXPECT_EQ("TrelException: Vesk::MultiElementValue::getElement: no child with key 'Description'",
              thrown([&] { root.getMultiElement().getElement("Description"); }));
    std::string tags;
    for (auto it = children.begin("Tag"); it != children.end("Tag"); ++it) {
        tags += textOf(*it);
    }
    EXPECT_EQ("ab", tags);
    EXPECT_TRUE(children.begin("None") == children.end("None"));
}

TEST(VeskMultiElementValue, AddElementCopiesTakesOrMakesAndRefusesNull) {
    MultiElementValue children;
    Element original = textElement("Copied", "1");
    Element& copy = children.addElement(original);
    original.getSingle().assign("2");
    EXPECT_EQ("1", textOf(copy));
    Element* owned = new Element("Owned");
    EXPECT_EQ(owned, &children.addElement(owned));
    Element& made = children.addElement("Made", {{"n", "v"}}, 5);
    EXPECT_EQ(5, made.id());
    EXPECT_EQ(1u, made.attributes().size());
    EXPECT_THROW(children.addElement(static_cast<Element*>(nullptr)), TrelException);
    EXPECT_EQ(3u, children.size());
}

TEST(VeskMultiValue, CopiesDeeplyComparesByKindAndRefusesNull) {
    MultiValue values;
    values.addSingle().assign("one");
    values.addMulti().addMultiElement().addElement(textElement("Child", "c"));
    EXPECT_THROW(values.addValue(nullptr), TrelException);
    MultiValue copy(values);
    EXPECT_TRUE(copy.equals(values));
    copy.addSingle();
    EXPECT_FALSE(copy.equals(values));
    copy = values;
    EXPECT_TRUE(copy.equals(values));
    EXPECT_FALSE(values.equals(SingleValue("one")));
}

}  // namespace
}  // namespace Vesk
