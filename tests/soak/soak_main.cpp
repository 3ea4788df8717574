// soak: runs the soak and reports it.
//
//   soak [--steps N] [--seed S] [--trace] [--print-to PATH]
//
// Exits with 0 when every step held and nothing was leaked, with 1 when a
// step failed (the seed and the step are printed: run the same seed with
// --trace to see the way there) or the counts at the end differ from the
// start, with 2 on a bad argument.
#include "soak_run.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

namespace {

void Usage()
{
    std::fprintf(stderr, "usage: soak [--steps N] [--seed S] [--trace] [--print-to PATH]\n");
}

} // namespace

int main(int argc, char** argv)
{
    Soak::Options options;
    for (int i = 1; i < argc; ++i) {
        const std::string argument = argv[i];
        const bool hasValue = i + 1 < argc;
        if (argument == "--steps" && hasValue) {
            options.steps = std::strtoll(argv[++i], nullptr, 10);
        } else if (argument == "--seed" && hasValue) {
            options.seed = std::strtoull(argv[++i], nullptr, 10);
        } else if (argument == "--print-to" && hasValue) {
            options.printPath = argv[++i];
        } else if (argument == "--trace") {
            options.trace = true;
        } else {
            Usage();
            return 2;
        }
    }

    std::printf("soak: seed %llu, %lld steps\n", static_cast<unsigned long long>(options.seed), options.steps);
    std::fflush(stdout);
    const Soak::Result result = Soak::Run(options);
    std::printf("%s\n", Soak::Describe(result).c_str());
    std::printf("steps per action:");
    for (int action = 0; action < Soak::ActionCount; ++action)
        std::printf("%s %s %lld", action ? "," : "", Soak::NameOf(static_cast<Soak::Action>(action)),
                    result.actions[static_cast<size_t>(action)]);
    std::printf("\n");
    const Soak::Events& e = result.events;
    std::printf("events: %lld paints, %lld clicks, %lld double clicks, %lld rubber rectangles, %lld drags and "
                "drops, %lld data tips shown, %lld pages printed\n",
                e.paints, e.clicks, e.doubleClicks, e.rubberRectangles, e.dragAndDrops, e.dataTipsShown,
                e.pagesPrinted);
    return result.IsClean() ? 0 : 1;
}
