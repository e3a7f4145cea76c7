// The element tree itself: values, copies, moves, lookups, equality and their exceptions.
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "Vesk/Element.h"
#include "XmlTestSupport.h"

namespace Vesk {
namespace {

Element withText(const char* key, const char* text) {
    Element element(key);
    element.addSingle().assign(text);
    return element;
}

// Root "Root" with children Tag="a", Tag="b", Value (no value) and a list holding nested lists.
Element sampleTree(const char* nested = "y") {
    Element root("Root");
    root.insertAttributes({{"version", "2"}, {"kind", "sample"}});
    MultiElementValue& children = root.addMultiElement();
    children.addElement(withText("Tag", "a"));
    children.addElement(withText("Tag", "b"));
    children.addElement("Value", Attributes(), -1);
    MultiValue& list = children.addElement(new Element("List")).addMulti();
    list.addSingle().assign("x");
    list.addMulti().addSingle().assign(nested);
    list.addMultiElement().addElement(withText("Inner", "z"));
    return root;
}

std::string textOf(const Element& element) {
    return element.getSingle().value().c_str();
}

TEST(VeskElement, NewElementHasKeyAndNoValue) {
    const Element element("Key", -1);
    EXPECT_STREQ("Key", element.key().c_str());
    EXPECT_EQ(-1, element.id());
    EXPECT_FALSE(element.hasValue());
    EXPECT_TRUE(element.attributes().empty());
}

TEST(VeskElement, ReadingAMissingValueThrowsNoValueSetEx) {
    Element element("Tag");
    const Element& constant = element;
    EXPECT_THROW(element.getSingle(), Element::NoValueSetEx);
    EXPECT_THROW(constant.getSingle(), Element::NoValueSetEx);
    EXPECT_THROW(element.getMulti(), Element::NoValueSetEx);
    EXPECT_THROW(constant.getMultiElement(), Element::NoValueSetEx);
    EXPECT_THROW(constant.value(), Element::NoValueSetEx);
    try {
        element.getSingle();
        FAIL();
    } catch (const Element::NoValueSetEx& e) {
        EXPECT_NE(std::string::npos, std::string(e.what()).find("'Tag'"));
    }
}

TEST(VeskElement, ReadingAValueOfAnotherKindThrowsTrelExceptionNotNoValue) {
    Element element("Flags");
    element.addMulti();
    const Element& constant = element;
    EXPECT_NO_THROW(constant.getMulti());
    try {
        constant.getSingle();
        FAIL();
    } catch (const Element::NoValueSetEx&) {
        FAIL() << "a value of another kind is not a missing value";
    } catch (const TrelException& e) {
        EXPECT_NE(std::string::npos, std::string(e.what()).find("'Flags'"));
        EXPECT_NE(std::string::npos, std::string(e.what()).find("multi value"));
    }
    EXPECT_THROW(element.getMultiElement(), TrelException);
}

TEST(VeskElement, AddReplacesTheValueAndSetValueNullRemovesIt) {
    Element element("Key");
    element.addSingle().assign("one");
    EXPECT_EQ("one", textOf(element));
    element.addMultiElement();
    EXPECT_EQ(Value::Kind::MultiElement, element.value().kind());
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
    ASSERT_EQ(3u, element.attributes().size());
    EXPECT_STREQ("b", element.attributes()[1].first.c_str());
    bool found = false;
    EXPECT_STREQ("1", element.getAttributeValue("a", found).c_str());
    EXPECT_TRUE(found);
    EXPECT_TRUE(element.getAttributeValue("c", found).empty());
    EXPECT_FALSE(found);
}

TEST(VeskElement, CopiesAreDeep) {
    const Element original = sampleTree();
    Element copy(original);
    EXPECT_EQ(original, copy);
    copy.getMultiElement().getElement("Tag").getSingle().assign("changed");
    EXPECT_EQ("a", textOf(original.getMultiElement().getElement("Tag")));
    EXPECT_NE(original, copy);

    Element assigned("Other");
    assigned = original;
    EXPECT_EQ(original, assigned);
    assigned = assigned;  // self-assignment keeps the tree
    EXPECT_EQ(original, assigned);
}

TEST(VeskElement, MovesTakeTheTreeAndLeaveAnEmptyElement) {
    Element source = sampleTree();
    const Element expected = sampleTree();
    Element moved(std::move(source));
    EXPECT_EQ(expected, moved);
    EXPECT_FALSE(source.hasValue());
    EXPECT_TRUE(source.key().empty());

    Element target("Old");
    target.addSingle().assign("old");
    target = std::move(moved);
    EXPECT_EQ(expected, target);
    EXPECT_FALSE(moved.hasValue());
    EXPECT_TRUE(moved.attributes().empty());
}

TEST(VeskElement, ChildrenAndGivenValuesStayWhereTheyAreWhenTheElementMoves) {
    Element list("List");
    MultiElementValue& children = list.addMultiElement();
    Element& first = children.addElement(withText("First", "1"));
    for (int i = 0; i < 100; ++i) {
        children.addElement(withText("Sibling", "s"));  // the children's vector grows meanwhile
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
    EXPECT_EQ(withText("Tag", "a"), other);
}

TEST(VeskElement, LongKeysAndTextsSurviveCopiesAndMoves) {
    const std::string longKey(100, 'k');
    const std::string longText(1000, 't');
    Element element(longKey.c_str(), longKey.size(), -1);
    element.addSingle().assign(longText.c_str());
    Element copy(element);
    Element moved(std::move(element));
    EXPECT_EQ(copy, moved);
    EXPECT_EQ(longKey, moved.key().c_str());
    EXPECT_EQ(longText, textOf(moved));
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

    EXPECT_NE(base, sampleTree("Y"));  // a text deep in a list of lists

    // The id is not part of the tree's contents.
    EXPECT_EQ(Element("K", 7), Element("K", -1));
    // No value differs from an empty text.
    Element emptyText("K");
    emptyText.addSingle();
    EXPECT_NE(Element("K"), emptyText);
    // Values of different kinds differ even when both are empty.
    Element emptyMulti("K");
    emptyMulti.addMulti();
    Element emptyList("K");
    emptyList.addMultiElement();
    EXPECT_NE(emptyMulti, emptyList);
}

TEST(VeskMultiElementValue, GetElementFindsTheFirstChildWithTheKey) {
    const Element root = sampleTree();
    const MultiElementValue& children = root.getMultiElement();
    EXPECT_EQ("a", textOf(children.getElement("Tag")));
    EXPECT_TRUE(children.has("Value"));
    EXPECT_FALSE(children.has("tag"));  // keys compare exactly
    EXPECT_EQ(nullptr, children.find("Missing"));
    EXPECT_EQ(4u, children.size());
}

TEST(VeskMultiElementValue, GetElementOfAMissingKeyThrowsNamingTheKey) {
    Element root = sampleTree();
    try {
        root.getMultiElement().getElement("Description");
        FAIL();
    } catch (const Element::NoValueSetEx&) {
        FAIL() << "a missing child is not a missing value";
    } catch (const TrelException& e) {
        EXPECT_NE(std::string::npos, std::string(e.what()).find("'Description'"));
    }
}

TEST(VeskMultiElementValue, KeyIteratorsVisitOnlyThatKeyInOrder) {
    const Element root = sampleTree();
    const MultiElementValue& children = root.getMultiElement();
    std::vector<std::string> tags;
    for (auto it = children.begin("Tag"); it != children.end("Tag"); ++it) {
        tags.push_back(textOf(*it));
    }
    EXPECT_EQ((std::vector<std::string>{"a", "b"}), tags);
    EXPECT_TRUE(children.begin("None") == children.end("None"));
    std::vector<std::string> keys;
    for (const Element& child : children) {
        keys.push_back(child.key().c_str());
    }
    EXPECT_EQ((std::vector<std::string>{"Tag", "Tag", "Value", "List"}), keys);
}

TEST(VeskMultiElementValue, AddElementVariants) {
    MultiElementValue children;
    Element original = withText("Copied", "1");
    Element& copy = children.addElement(original);
    original.getSingle().assign("2");
    EXPECT_EQ("1", textOf(copy));  // addElement(const Element&) copies

    Element* owned = new Element("Owned");
    EXPECT_EQ(owned, &children.addElement(owned));  // addElement(Element*) takes it as it is

    Element& made = children.addElement("Made", {{"n", "v"}}, 5);
    EXPECT_EQ(5, made.id());
    EXPECT_EQ(1u, made.attributes().size());
    EXPECT_FALSE(made.hasValue());
    EXPECT_EQ(3u, children.size());
}

TEST(VeskMultiElementValue, AddingANullChildThrows) {
    MultiElementValue children;
    EXPECT_THROW(children.addElement(static_cast<Element*>(nullptr)), TrelException);
    EXPECT_EQ(0u, children.size());
}

TEST(VeskMultiValue, HoldsValuesOfEveryKindInOrderAndCopiesDeeply) {
    MultiValue values;
    values.addSingle().assign("one");
    values.addMulti().addSingle().assign("nested");
    values.addMultiElement().addElement(withText("Child", "c"));
    values.addValue(std::make_unique<SingleValue>(ACE_CString("last")));
    EXPECT_THROW(values.addValue(nullptr), TrelException);
    ASSERT_EQ(4u, values.size());
    std::vector<Value::Kind> kinds;
    for (const Value& value : values) {
        kinds.push_back(value.kind());
    }
    EXPECT_EQ((std::vector<Value::Kind>{Value::Kind::Single, Value::Kind::Multi,
                                        Value::Kind::MultiElement, Value::Kind::Single}),
              kinds);

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
