// Which host the library finds, in programs of their own: binding lasts for the life of a process.

#include <gtest/gtest.h>
#include <sys/wait.h>

#include <array>
#include <cstdio>
#include <string>

namespace krnumer {
namespace {

struct Outcome {
    int exit_code;
    std::string text;  // standard output and error
};

Outcome RunProgram(const std::string& program, const std::string& arguments, const std::string& environment = "") {
    FILE* const pipe = popen((environment + " '" + program + "' " + arguments + " 2>&1").c_str(), "r");
    Outcome outcome{-1, ""};
    std::array<char, 256> line;
    while (std::fgets(line.data(), line.size(), pipe) != nullptr) outcome.text += line.data();
    outcome.exit_code = WEXITSTATUS(pclose(pipe));
    return outcome;
}

const std::string kNoHost = "KORVANE.LIB was not called from a Korvane process.";
const std::string kNoService = "KORVANE.LIB could not locate \"ResizeNumberBlock\".";
const std::string kEmptied = "status -20003, sizes 0 0\n";

void ExpectFatal(const Outcome& outcome, const std::string& message) {
    EXPECT_EQ(outcome.exit_code, 1);
    EXPECT_NE(outcome.text.find(message), std::string::npos) << outcome.text;
    EXPECT_EQ(outcome.text.find("status"), std::string::npos) << "the call returned: " << outcome.text;
}

void ExpectServedBy(const std::string& server, const Outcome& outcome) {
    EXPECT_EQ(outcome.exit_code, 0);
    EXPECT_EQ(outcome.text, "served by " + server + "\nserved by " + server + "\n" + kEmptied);
}

TEST(Binding, EndsAProcessWithoutHost) {
    ExpectFatal(RunProgram(PROGRAM_none, "use"), kNoHost);
}

TEST(Binding, AsksForNoHostBeforeAnArrayIsWritten) {
    const Outcome outcome = RunProgram(PROGRAM_none, "quiet");
    EXPECT_EQ(outcome.exit_code, 0);
    EXPECT_EQ(outcome.text, "status -20003\n");
}

TEST(Binding, DoesNotLoadARunTimeModuleThatMerelyLiesOnTheSearchPath) {
    const std::string path(MODULE_run_time);
    const std::string folder = path.substr(0, path.rfind('/'));
    ExpectFatal(RunProgram(PROGRAM_none, "use", "LD_LIBRARY_PATH='" + folder + "'"), kNoHost);
}

TEST(Binding, FindsTheLoadedRunTimeModule) {
    ExpectServedBy("run_time", RunProgram(PROGRAM_none, std::string("load ") + MODULE_run_time + " use"));
}

TEST(Binding, PrefersAProgramThatMarksItself) {
    for (const char* program : {PROGRAM_version, PROGRAM_zone}) {
        ExpectServedBy("program", RunProgram(program, "use"));
        ExpectServedBy("program", RunProgram(program, std::string("load ") + MODULE_run_time + " use"));
    }
}

TEST(Binding, StopsAtAMarkedProgramEvenWithoutTheService) {
    ExpectFatal(RunProgram(PROGRAM_version_without_service, "use"), kNoService);
    ExpectFatal(RunProgram(PROGRAM_version_without_service, std::string("load ") + MODULE_run_time + " use"),
                kNoService);
}

TEST(Binding, TakesNoMarkOfALibraryForOneOfTheProgram) {
    const std::string load_marked = std::string("load ") + MODULE_marked;
    ExpectFatal(RunProgram(PROGRAM_none, load_marked + " use"), kNoHost);
    ExpectServedBy("run_time", RunProgram(PROGRAM_none, load_marked + " load " + MODULE_run_time + " use"));
}

TEST(Binding, LooksOnlyInTheNamedModule) {
    ExpectServedBy("named", RunProgram(PROGRAM_version, std::string("name ") + MODULE_named + " use"));
    ExpectFatal(RunProgram(PROGRAM_version, std::string("name ") + MODULE_bare + " use"), kNoService);
}

TEST(Binding, ReturnsToTheLookUpWhenNoModuleIsNamed) {
    ExpectServedBy("program", RunProgram(PROGRAM_version, std::string("name ") + MODULE_named + " unname use"));
}

TEST(Binding, KeepsAServiceOnceItIsFound) {
    const Outcome outcome = RunProgram(PROGRAM_version, std::string("use name ") + MODULE_named + " use");
    EXPECT_EQ(outcome.exit_code, 0);
    EXPECT_EQ(outcome.text.find("named"), std::string::npos) << outcome.text;
}

}  // namespace
}  // namespace krnumer
