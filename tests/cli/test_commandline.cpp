#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "commandline.h"

namespace {

ParseResult parse(std::vector<const char*> args, CommandLine& out) {
    args.insert(args.begin(), "kxvalidate");
    return parseCommandLine(static_cast<int>(args.size()), args.data(), out);
}

TEST(CommandLine, ReadsEveryOptionInBothSpellings) {
    CommandLine cmd;
    const ParseResult r =
        parse({"-s", "a.xml", "--unicode", "-o", "X=1", "--option=Y=a=b", "--plugin", "p.so",
               "--format=json", "-q", "-j", "4", "f1", "--", "-f2"},
              cmd);
    ASSERT_EQ(r.action, ParseResult::Run) << r.error;
    EXPECT_EQ(cmd.schema, "a.xml");
    EXPECT_TRUE(cmd.unicode);
    ASSERT_EQ(cmd.options.size(), 2u);
    EXPECT_EQ(cmd.options[1].first, "Y");
    EXPECT_EQ(cmd.options[1].second, "a=b");
    EXPECT_EQ(cmd.plugin, "p.so");
    EXPECT_EQ(cmd.format, OutputFormat::Json);
    EXPECT_TRUE(cmd.quiet);
    EXPECT_EQ(cmd.jobs, 4);
    EXPECT_EQ(cmd.files, (std::vector<std::string>{"f1", "-f2"}));
}

TEST(CommandLine, RefusesWhatItCannotUse) {
    const std::vector<std::vector<const char*>> bad = {
        {},
        {"--bogus", "f"},
        {"-o", "novalue", "f"},
        {"-o", "=1", "f"},
        {"--format", "xml", "f"},
        {"-j", "0", "f"},
        {"-j", "2x", "f"},
        {"f", "-s"},
    };
    for (const auto& args : bad) {
        CommandLine cmd;
        EXPECT_EQ(parse(args, cmd).action, ParseResult::UsageError)
            << (args.empty() ? "(none)" : args[0]);
    }
    CommandLine cmd;
    EXPECT_EQ(parse({"f", "--help"}, cmd).action, ParseResult::Help);
    EXPECT_EQ(parse({"--version"}, cmd).action, ParseResult::Version);
}

}  // namespace
