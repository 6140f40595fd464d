#include "serve/FaultScript.h"

#include <gtest/gtest.h>

namespace ktr::test {

using documents::DocumentError;
using serve::Fault;
using serve::FaultScript;

class FaultScriptTest : public ::testing::Test {
  protected:
    static Fault words(const std::string& text) {
        std::string complaint;
        const auto fault = FaultScript::readWords(text, complaint);
        EXPECT_TRUE(fault.has_value()) << complaint;
        return fault.value_or(Fault());
    }
    static std::string complaintOf(const std::string& text) {
        std::string complaint = "no complaint";
        EXPECT_EQ(FaultScript::readWords(text, complaint), std::nullopt);
        return complaint;
    }
};

TEST_F(FaultScriptTest, Words_AndFile_SayTheSame) {
    const auto read = FaultScript::readText(R"({"faults": [
        {"at": 2, "count": 3, "delay": 1.5, "cut": "body", "status": 503, "redirect": "{origin}/a,b", "redirectStatus": 308,
         "body": "deep", "bytesPerSecond": 10, "statusCode": 416, "entryStatus": 411, "entry": "a@b.example", "interval": 0}]})",
                                            "f.json");
    ASSERT_TRUE(std::holds_alternative<FaultScript>(read));
    const Fault inWords = words(
        "at=2,count=3,delay=1.5,cut=body,status=503,redirect={origin}/"
        "a,,b,redirectStatus=308,body=deep,bytesPerSecond=10,"
        "statusCode=416,entryStatus=411,entry=a@b.example,interval=0");
    ASSERT_EQ(std::get<FaultScript>(read).faults().size(), 1U);
    EXPECT_EQ(std::get<FaultScript>(read).faults()[0], inWords);
    EXPECT_EQ(inWords.cut, Fault::Cut::InBody);
    EXPECT_EQ(inWords.redirect, "{origin}/a,b");
    EXPECT_EQ(inWords.intervalSeconds, 0.0);
    EXPECT_EQ(words("text=12").text, "12");
}

TEST_F(FaultScriptTest, Request_GetsTheFirstFaultThatConcernsIt) {
    FaultScript script;
    script.add(words("status=500,at=2,count=2"));
    script.add(words("status=503,at=3"));
    EXPECT_EQ(script.faultFor(1), Fault());
    EXPECT_EQ(script.faultFor(2).status, 500);
    EXPECT_EQ(script.faultFor(3).status, 500);
    EXPECT_EQ(script.faultFor(4).status, 503);
    EXPECT_EQ(script.faultFor(1000).status, 503);
}

TEST_F(FaultScriptTest, WhatIsNoFault_IsRefused) {
    EXPECT_EQ(complaintOf("statos=503"), "$.statos: there is no such fault; did you mean \"status\"?");
    EXPECT_EQ(complaintOf("status=five"), "$.status: expected a whole number from 200 to 599, found a string");
    EXPECT_EQ(complaintOf("status=99"), "$.status: expected a whole number from 200 to 599");
    EXPECT_EQ(complaintOf("at=1.5"), "$.at: expected a whole number from 1 to 1000000000");
    EXPECT_EQ(complaintOf("cut=somewhere").rfind("$.cut: expected one of before, headers, body, found ", 0), 0U);
    EXPECT_EQ(complaintOf("status").rfind("expected words such as status=503,at=2", 0), 0U);
    EXPECT_EQ(complaintOf("delay=-1"), "$.delay: expected a number from 0 to 1000000000");
    EXPECT_EQ(complaintOf("interval=1e308"), "$.interval: expected a number from -1000000000 to 1000000000");
    const auto read = FaultScript::readText(R"({"faults": [{"delay": "long"}]})", "f.json");
    ASSERT_TRUE(std::holds_alternative<DocumentError>(read));
    EXPECT_EQ(std::get<DocumentError>(read).text(),
              "f.json:1:23: $.faults[0].delay: expected a number, found a string");
}

}  // namespace ktr::test
