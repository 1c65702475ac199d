#include "platform/port/CmdArgs.h"

#include "Collector.h"
#include "platform/port/CmdOpcodes.h"
#include "platform/port/detail/OptionSpec.h"

#include <algorithm>
#include <cstdlib>
#include <gtest/gtest.h>
#include <sstream>

namespace {

using Lines = std::vector<std::string>;

const char* const board = "# The drawing application\n"
                          "scale    real               : Scale of the first view; 1 is full size.\n"
                          "layer    text repeatable    : Layer to show: its name.\n"
                          "count    integer            : Number of views.\n"
                          "\n"
                          "smoketest none              : Start, check and end.\r\n"
                          "nosplash none\n"
                          "<drawing> 0..3              : Drawings to open.\n";

int usageCalls = 0;

struct Outcome {
    bool gaveUsage;
    bool isError;
    Lines errors;
};

Outcome check(const char* specification, const std::vector<const char*>& arguments,
              unsigned short flags = UT_CMDARGS::NoProgramName) {
    Collector collector;
    usageCalls = 0;
    const UT_CMDARGS args(
        static_cast<int>(arguments.size()), arguments.data(), specification, [] { ++usageCalls; }, flags);
    return {args.gaveusage(), args.iserror(), collector.texts()};
}

Lines errors(const char* specification, const std::vector<const char*>& arguments) {
    const Outcome outcome = check(specification, arguments);
    EXPECT_EQ(outcome.isError, !outcome.errors.empty());
    EXPECT_FALSE(outcome.gaveUsage);
    return outcome.errors;
}

std::string usage(const char* specification) {
    char* text = UT_CMDOPCODES(specification).usage();
    const std::string result = text;
    std::free(text);
    return result;
}

TEST(CmdArgs, AcceptsWhatTheSpecificationAllows) {
    EXPECT_EQ(errors(board, {}), Lines{});
    EXPECT_EQ(errors(board, {"-scale", "2.5", "a.brd", "-layer", "top", "-layer", "bottom", "b.brd"}), Lines{});
    EXPECT_EQ(errors(board, {"-SmokeTest", "-nosplash", "-", "/tmp/c.brd"}), Lines{});
    EXPECT_EQ(errors(board, {"-scale", "-1e-3", "-count", "-7"}), Lines{}) << "negative numbers are values";
    EXPECT_EQ(errors(board, {"-count", "99999999999999999999"}), Lines{}) << "clamps when it is read";
    EXPECT_EQ(errors(board, {"-sc", "1", "-sm"}), Lines{}) << "unique abbreviations";
}

TEST(CmdArgs, NamesUnknownAndAmbiguousOptions) {
    EXPECT_EQ(errors(board, {"-bogus", "x", "-scalex"}),
              (Lines{"Unknown option \"-bogus\".", "Unknown option \"-scalex\"."}));
    EXPECT_EQ(errors(board, {"-s"}), Lines{"Option \"-s\" is ambiguous: it may mean -scale or -smoketest."});
    EXPECT_EQ(errors("a none\nab none", {"-a"}), Lines{}) << "a full name is no abbreviation";
    EXPECT_EQ(errors(board, {"--scale"}), Lines{"Unknown option \"--scale\"."});
}

TEST(CmdArgs, NamesMissingAndMalformedValues) {
    EXPECT_EQ(errors(board, {"-scale"}), Lines{"Option \"-scale\" needs a number after it."});
    EXPECT_EQ(errors(board, {"-layer", "-nosplash"}), Lines{"Option \"-layer\" needs a text after it."});
    EXPECT_EQ(errors(board, {"-scale", "2.5kg"}), Lines{"Option \"-scale\": \"2.5kg\" is not a number."});
    EXPECT_EQ(errors(board, {"-count", "2.5"}), Lines{"Option \"-count\": \"2.5\" is not a whole number."});
    EXPECT_EQ(errors(board, {"-count", ""}), Lines{"Option \"-count\": \"\" is not a whole number."});
}

TEST(CmdArgs, ChecksCounts) {
    EXPECT_EQ(errors(board, {"-count", "1", "-COUNT", "2", "-count", "3"}),
              Lines{"Option \"-count\" is given more than once."});
    EXPECT_EQ(errors(board, {"1", "2", "3", "4", "5"}),
              Lines{"Unexpected argument \"4\": 3 <drawing> allowed, 5 given."});
    EXPECT_EQ(errors("out text required", {"x"}),
              (Lines{"Option \"-out\" is required.", "Unexpected argument \"x\"."}));
    EXPECT_EQ(errors("<name> 2", {"x"}), Lines{"Too few arguments: 2 <name> needed, 1 given."});
    EXPECT_EQ(errors("<name> 1..*", std::vector<const char*>(1000, "x")), Lines{});
}

TEST(CmdArgs, ReportsEverythingThatIsWrong) {
    EXPECT_EQ(errors(board, {"-bogus", "-scale", "x", "-s", "-layer"}).size(), 4u);
}

TEST(CmdArgs, HelpGivesUsageAndNothingElse) {
    for (const char* help : {"-help", "-H", "-?", "-hel"}) {
        const Outcome outcome = check(board, {"-bogus", help, "-scale"});
        EXPECT_TRUE(outcome.gaveUsage) << help;
        EXPECT_FALSE(outcome.isError);
        EXPECT_EQ(outcome.errors, Lines{usage(board) + "\n"});
        EXPECT_EQ(usageCalls, 1);
    }
    EXPECT_FALSE(check(board, {"-helpme"}).gaveUsage);
    EXPECT_TRUE(check("help none : My own words.", {"-help"}).gaveUsage);
    EXPECT_TRUE(check("height integer", {"-h"}).gaveUsage) << "\"h\" is no abbreviation";
    EXPECT_TRUE(check(nullptr, {"-help"}).gaveUsage);
    check(board, {"-bogus"});
    EXPECT_EQ(usageCalls, 0);
}

TEST(CmdArgs, WithoutTheFlagElementZeroIsTheProgram) {
    EXPECT_FALSE(check("", {"-program"}, 0).isError);
    EXPECT_TRUE(check("", {"program", "x"}, 0).isError);
    EXPECT_FALSE(check("", {}, 0).isError);
}

TEST(CmdArgs, ManyArgumentsTakeLinearWork) {
    const std::vector<const char*> arguments(200'000, "-layer");
    EXPECT_EQ(errors(board, arguments).size(), arguments.size()) << "each lacks its value";
}

TEST(OptionSpec, MistakesAreInternalErrorsThatNameTheLine) {
    struct Case {
        const char* line;
        const char* reason;
    };
    for (const auto& [line, reason] : std::initializer_list<Case>{
             {"1st none", "\"1st\" cannot be the name of an option"},
             {"-scale real", "\"-scale\" cannot be the name of an option"},
             {"scale", "option \"scale\" has no value kind (none, text, integer, real)"},
             {"scale float", "\"float\" is no value kind (none, text, integer, real)"},
             {"scale real Scale of it",
              "\"Scale\" is neither \"required\" nor \"repeatable\" (help texts begin with \":\")"},
             {"GOOD none", "option \"GOOD\" is there already"},
             {"f none", "\"f\" has a fixed meaning on every command line"},
             {"H none", "\"H\" has a fixed meaning on every command line"},
             {"help text", "option \"help\" cannot take a value or be required"},
             {": text", "there is nothing before \":\""},
             {"<a 1", "\">\" is missing"},
             {"< > 1", "the plain arguments have no name between \"<\" and \">\""},
             {"<a>", "\"\" is no count range such as \"1\", \"0..3\" or \"1..*\""},
             {"<a> 3..1", "\"3..1\" is no count range such as \"1\", \"0..3\" or \"1..*\""},
             {"<a> *", "\"*\" is no count range such as \"1\", \"0..3\" or \"1..*\""},
         }) {
        Collector collector;
        const std::string specification = "good none\r\n\n" + std::string(line) + "\r";
        const char* argument = "-whatever";
        const UT_CMDARGS args(1, &argument, specification.c_str(), nullptr, UT_CMDARGS::NoProgramName);
        EXPECT_TRUE(args.iserror());
        ASSERT_EQ(collector.messages.size(), 1u) << line << ": the arguments are not checked then";
        EXPECT_EQ(collector.messages[0].type, Port_MsgMan::MsgTypeInternal);
        EXPECT_EQ(collector.messages[0].text, "Line 3 of the option specification: " + std::string(reason) + ".");
    }
}

TEST(CmdOpcodes, UsageShowsEveryOptionWithItsHelp) {
    const std::string text = usage("scale real required : Scale; 1 is full size.\nlayer text repeatable\n"
                                   "<drawing> 1..* : Drawings to open.");
    EXPECT_EQ(text.substr(text.find(" -scale")), " -scale <number> [options] <drawing> ...\n"
                                                 "  <drawing>  (at least 1)\n"
                                                 "      Drawings to open.\n"
                                                 "  -scale <number>  (required)\n"
                                                 "      Scale; 1 is full size.\n"
                                                 "  -layer <text>  (repeatable)\n"
                                                 "  -help\n"
                                                 "      Show this summary.\n"
                                                 "  -f <file> ...\n"
                                                 "      Take arguments from files.\n");
    EXPECT_TRUE(text.starts_with("Usage: "));
    const std::string own = usage("help none : Mine.\nf text : My files.");
    EXPECT_NE(own.find("  -help\n      Mine.\n  -f <file> ...\n      My files.\n"), std::string::npos) << own;
}

TEST(CmdOpcodes, UsageWrapsAtEightyColumnsUnderTheHelp) {
    std::string help;
    for (int i = 0; i < 40; ++i) {
        help += "word" + std::to_string(i) + ' ';
    }
    std::istringstream lines(usage(("scale real : " + help).c_str()));
    int indented = 0;
    for (std::string line; std::getline(lines, line);) {
        EXPECT_LE(line.size(), 80u);
        indented += line.starts_with("      word") ? 1 : 0;
    }
    EXPECT_GE(indented, 3);
}

TEST(CmdOpcodes, ResolvesAbbreviations) {
    const UT_CMDOPCODES opcodes(board);
    EXPECT_STREQ(opcodes.optionname("SCALE"), "scale");
    EXPECT_STREQ(opcodes.optionname("sm"), "smoketest");
    EXPECT_STREQ(opcodes.optionname("?"), "help");
    EXPECT_EQ(opcodes.optionname("s"), nullptr);
    EXPECT_EQ(opcodes.optionname(""), nullptr);
    EXPECT_EQ(opcodes.optionname(nullptr), nullptr);
}

} // namespace
