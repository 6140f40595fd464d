#include "server/page/Html.h"

#include <gtest/gtest.h>

namespace ktr::test {

using server::Html;

TEST(HtmlTest, Escaped_LeavesNothingThatIsMarkup) {
    EXPECT_EQ(Html::escaped("<b onclick=\"x('&')\">"), "&lt;b onclick=&quot;x(&#39;&amp;&#39;)&quot;&gt;");
    EXPECT_EQ(Html::escaped("a\nb\0c\x7F"), "a b");
    EXPECT_EQ(Html::escaped(std::string("a\nb\0c\x7F", 6)), "a b c ");
    EXPECT_EQ(Html::escaped("נועם 🙂"), "נועם 🙂");
}

TEST(HtmlTest, Escaped_MalformedBytesBecomeOneReplacement) {
    EXPECT_EQ(Html::escaped("a\xFF<"), "a\uFFFD&lt;");
}

TEST(HtmlTest, TextsAndAttributesAreEscaped) {
    Html html;
    html.open("p", {{"title", "\"><script>"}}).text("<i>").single("input", {{"value", "'"}, {"checked", ""}});
    EXPECT_EQ(html.take(), "<p title=\"&quot;&gt;&lt;script&gt;\">&lt;i&gt;<input value=\"&#39;\" checked></p>");
}

TEST(HtmlTest, Take_ClosesWhatIsOpenInOrder_AndStartsAnew) {
    Html html;
    html.open("ul").open("li").leaf("b", {}, "x");
    EXPECT_EQ(html.take(), "<ul><li><b>x</b></li></ul>");
    EXPECT_EQ(html.text("y").take(), "y");
}

}  // namespace ktr::test
