#include "apps/cli/launcher.h"

#include <map>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ryn::cli {
namespace {

using testing::AllOf;
using testing::HasSubstr;
using Variables = std::map<std::string, std::string>;

Status Ask(const Variables& variables, int parts, int* part) {
    const Environment environment = [&](const std::string& name) -> std::optional<std::string> {
        const auto found = variables.find(name);
        return found != variables.end() ? std::optional(found->second) : std::nullopt;
    };
    return PartOfLauncher(environment, parts, part);
}

/// The part that an environment makes of one of `parts`.
int PartIn(const Variables& variables, int parts) {
    int part = 0;
    const Status status = Ask(variables, parts, &part);
    EXPECT_TRUE(status) << status.Text();
    return part;
}

/// Why an environment is refused.
std::string Refusal(const Variables& variables, int parts) {
    int part = 7;
    const Status status = Ask(variables, parts, &part);
    EXPECT_EQ(status.Kind(), Fault::Input);
    EXPECT_EQ(part, 7);
    return status.Text();
}

/// What Slurm sets in a batch script: of a job, and of an array's task.
Variables Job(const char* tasks) {
    return {{"SLURM_PROCID", "0"}, {"SLURM_NTASKS", tasks}};
}

Variables ArrayTask(const char* id, const char* first, const char* step, const char* count) {
    Variables variables = Job("1");
    variables.merge(Variables{{"SLURM_ARRAY_TASK_ID", id},
                              {"SLURM_ARRAY_TASK_MIN", first},
                              {"SLURM_ARRAY_TASK_STEP", step},
                              {"SLURM_ARRAY_TASK_COUNT", count}});
    return variables;
}

Variables MpiRank(const char* rank, const char* size) {
    return {{"OMPI_COMM_WORLD_RANK", rank}, {"OMPI_COMM_WORLD_SIZE", size}, {"PMIX_RANK", rank}};
}

/// What srun adds or puts in place of the script's.
Variables Step(const char* rank, const char* tasks) {
    return {{"SLURM_PROCID", rank}, {"SLURM_NTASKS", tasks}, {"SLURM_STEP_NUM_TASKS", tasks}};
}

/// Variables set around a process, and over them those of what was started inside.
Variables Within(const Variables& outer, Variables inner) {
    inner.insert(outer.begin(), outer.end());
    return inner;
}

TEST(Launcher, CountsRanksFromZeroAndSequencesFromOne) {
    EXPECT_EQ(PartIn(MpiRank("0", "2"), 2), 1);
    EXPECT_EQ(PartIn({{"PMI_RANK", "3"}, {"PMI_SIZE", "4"}}, 4), 4);
    EXPECT_EQ(PartIn({{"PMIX_RANK", "1"}}, 4), 2);
    EXPECT_EQ(PartIn(Step("1", "2"), 2), 2);
    EXPECT_EQ(PartIn({{"PARALLEL_SEQ", "3"}}, 4), 3);
}

TEST(Launcher, TakesTheNumberWithinAWholeArray) {
    EXPECT_EQ(PartIn(ArrayTask("1", "1", "1", "4"), 4), 1);
    EXPECT_EQ(PartIn(ArrayTask("3", "0", "1", "4"), 4), 4);
    EXPECT_EQ(PartIn(ArrayTask("14", "10", "2", "4"), 4), 3);
    EXPECT_EQ(PartIn(ArrayTask("0", "0", "1", "1"), 1), 1);
}

TEST(Launcher, TakesTasksSubmittedAgainByTheirOwnNumbers) {
    EXPECT_EQ(PartIn(ArrayTask("3", "3", "1", "1"), 4), 3);
    EXPECT_EQ(PartIn(ArrayTask("4", "2", "1", "2"), 4), 4);
    EXPECT_THAT(Refusal(ArrayTask("0", "0", "1", "1"), 4),
                AllOf(HasSubstr("SLURM_ARRAY_TASK_ID is 0"), HasSubstr("--array=1-4")));
}

TEST(Launcher, BelievesTheInnermostOfSeveral) {
    EXPECT_EQ(PartIn(Within(Job("4"), MpiRank("2", "4")), 4), 3);
    EXPECT_EQ(PartIn(Within(ArrayTask("1", "1", "1", "4"), MpiRank("2", "4")), 4), 3);
    EXPECT_EQ(PartIn(Within(ArrayTask("1", "1", "1", "9"), Step("2", "4")), 4), 3);
    EXPECT_EQ(PartIn(Within({{"PARALLEL_SEQ", "2"}}, MpiRank("2", "4")), 4), 3);
}

TEST(Launcher, LearnsNothingFromOneProcessAlone) {
    Variables single = Step("0", "1");
    single.merge(Variables{{"PMI_RANK", "0"}, {"PMI_SIZE", "1"}});
    EXPECT_EQ(PartIn(Within(ArrayTask("3", "1", "1", "4"), single), 4), 3);
    EXPECT_EQ(PartIn(Within({{"PARALLEL_SEQ", "2"}}, single), 4), 2);
    EXPECT_THAT(Refusal(single, 4), AllOf(HasSubstr("PMI_SIZE is 1"), HasSubstr("--parts is 4")));
}

TEST(Launcher, GivesABatchScriptNoNumberThoughItsJobHasTasks) {
    EXPECT_THAT(Refusal(Job("4"), 4), HasSubstr("no launcher"));
    EXPECT_THAT(Refusal({}, 4), HasSubstr("no launcher"));
}

TEST(Launcher, IsRefusedWhereItStartedAnotherNumberOfProcesses) {
    EXPECT_THAT(Refusal(MpiRank("0", "3"), 2),
                AllOf(HasSubstr("OMPI_COMM_WORLD_SIZE is 3"), HasSubstr("--parts is 2")));
    EXPECT_THAT(Refusal(Step("0", "8"), 4), HasSubstr("SLURM_STEP_NUM_TASKS is 8"));
    EXPECT_THAT(Refusal(ArrayTask("2", "1", "1", "8"), 4), HasSubstr("TASK_COUNT is 8"));
    EXPECT_THAT(Refusal({{"PARALLEL_SEQ", "5"}}, 4), HasSubstr("PARALLEL_SEQ makes this part 5"));
}

TEST(Launcher, IsRefusedWhereAnArrayAndParallelDisagree) {
    EXPECT_THAT(Refusal(Within(ArrayTask("3", "1", "1", "4"), {{"PARALLEL_SEQ", "2"}}), 4),
                AllOf(HasSubstr("SLURM_ARRAY_TASK_ID"), HasSubstr("PARALLEL_SEQ")));
    EXPECT_EQ(PartIn(Within(ArrayTask("2", "1", "1", "4"), {{"PARALLEL_SEQ", "2"}}), 4), 2);
}

TEST(Launcher, IsRefusedWhereItsNumbersAreNone) {
    for (const char* text : {"one", "", "1.5", "99999999999"})
        EXPECT_THAT(Refusal({{"PARALLEL_SEQ", text}}, 4), HasSubstr("is no number"));
    EXPECT_THAT(Refusal(ArrayTask("3", "x", "1", "4"), 4), HasSubstr("SLURM_ARRAY_TASK_MIN"));
    // Nothing overflows on the way to the refusal.
    EXPECT_NE(Refusal({{"PMIX_RANK", "2147483647"}}, 4), "");
    EXPECT_NE(Refusal(ArrayTask("2147483647", "-2147483648", "1", "4"), 4), "");
    EXPECT_NE(Refusal(ArrayTask("3", "0", "2", "4"), 4), "");
    EXPECT_NE(Refusal(ArrayTask("3", "0", "-1", "4"), 4), "");
}

} // namespace
} // namespace ryn::cli
