#include "app/window/AskField.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QLineEdit>
#include <vector>

namespace ktr::test {

namespace {

using app::AskField;

/// Objects whose name was said to have changed.
std::vector<QObject*> named;

void note(QAccessibleEvent* event) {
    if (event->type() == QAccessible::NameChanged) {
        named.push_back(event->object());
    }
}

}  // namespace

TEST(AskFieldTest, TheSameTexts_AreNoChangeOfAName) {
    AskField field({"Ask about your friends", "Send"});
    named.clear();
    const auto before = QAccessible::installUpdateHandler(note);
    field.setTexts({"Ask about your friends", "Send"});
    EXPECT_TRUE(named.empty());
    // Where there is no room for a line of status, it stands in the field; what the field is called stays.
    field.setTexts({"Live", "Send", "Ask about your friends"});
    field.setTexts({"Frag nach deinen Freunden", "Senden"});
    EXPECT_FALSE(named.empty());
    QAccessible::installUpdateHandler(before);
    EXPECT_EQ(field.findChild<QLineEdit*>()->placeholderText().toStdString(), "Frag nach deinen Freunden");
    EXPECT_EQ(field.findChild<QLineEdit*>()->accessibleName().toStdString(), "Frag nach deinen Freunden");
}

}  // namespace ktr::test
