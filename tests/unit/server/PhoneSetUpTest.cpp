#include "server/answers/PhoneSetUp.h"

#include <gtest/gtest.h>
#include <openssl/evp.h>

#include <string>
#include <variant>

#include "documents/JsonReader.h"
#include "server/admin/TerminalCode.h"
#include "server/http/UrlQuery.h"

namespace ktr::test {

using server::PhoneSetUp;
using server::QrCode;

TEST(PhoneSetUpTest, Link_IsTheConfigurationThatTheAppReads) {
    const PhoneSetUp setUp = PhoneSetUp::of("https://home.example", "Ann?>", "secret~~~");
    const std::string link = setUp.link();
    const std::string head = "owntracks:///config?";
    ASSERT_EQ(link.rfind(head, 0), 0U);
    const auto coded = server::UrlQuery::read(link.substr(head.size())).find("inline");
    ASSERT_TRUE(coded && coded->size() % 4 == 0) << link;
    std::string plain(coded->size(), '\0');
    ASSERT_GT(EVP_DecodeBlock(reinterpret_cast<unsigned char*>(plain.data()),
                              reinterpret_cast<const unsigned char*>(coded->data()), static_cast<int>(coded->size())),
              0);
    plain.resize(plain.rfind('}') + 1);
    EXPECT_EQ(plain,
              R"({"_type":"configuration","mode":3,"url":"https://home.example/pub","auth":true,"username":"Ann?>",)"
              R"("password":"secret~~~"})");
    EXPECT_EQ(setUp.address(), "https://home.example/?id=secret~~~");
}

TEST(PhoneSetUpTest, Base64_HasNothingThatAQueryReadsOtherwise) {
    EXPECT_EQ(server::escapedBase64("\xfb\xff"), "%2B%2F8%3D");
    EXPECT_EQ(server::escapedBase64(""), "");
}

TEST(PhoneSetUpTest, CodeInATerminal_IsTheCode_WithItsQuietZone_AndFitsIntoEightyColumns) {
    const auto code =
        QrCode::of(PhoneSetUp::of("https://home.example:8443", "Annabel", "abcdefghijklmnopqrstuvwxyz").link());
    ASSERT_TRUE(code);
    const std::string text = server::terminalCode(*code, false);
    int row = -4;
    int column = -4;
    for (std::size_t i = 0; i < text.size();) {
        if (text[i] == '\n') {
            EXPECT_EQ(column, code->side + 4);
            column = -4;
            row += 2;
            ++i;
            continue;
        }
        const std::string letter = text.substr(i, text[i] == ' ' ? 1 : 3);
        for (int half = 0; half < 2; ++half) {
            const bool isWhite = letter == "█" || letter == (half == 0 ? "▀" : "▄");
            const int at = row + half;
            const bool inside = at >= 0 && at < code->side && column >= 0 && column < code->side;
            ASSERT_EQ(isWhite, !inside || !code->at(at, column)) << at << ", " << column;
        }
        ++column;
        i += letter.size();
    }
    EXPECT_GE(row, code->side + 4);
    EXPECT_LE(code->side + 8, 80);
}

}  // namespace ktr::test
