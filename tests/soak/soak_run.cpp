#include "soak_run.h"

#include "soak_engine.h"

#include <sstream>

namespace Soak {

namespace {

double Seconds(const LARGE_INTEGER& from, const LARGE_INTEGER& to)
{
    LARGE_INTEGER frequency;
    ::QueryPerformanceFrequency(&frequency);
    return static_cast<double>(to.QuadPart - from.QuadPart) / static_cast<double>(frequency.QuadPart);
}

} // namespace

Result Run(const Options& options)
{
    Result result;
    result.seed = options.seed;
    // Room for the report is made before anything is counted.
    result.failedAction.reserve(64);
    result.violation.reserve(512);
    {
        Engine engine(options);
        engine.WarmUp();
        result.before = engine.TakeBaseline();
        const std::string warmUpFault = engine.Check();
        if (!warmUpFault.empty()) {
            result.failedStep = 0;
            result.failedAction = "warm-up";
            result.violation = warmUpFault;
        }

        LARGE_INTEGER start;
        ::QueryPerformanceCounter(&start);
        for (long long step = 1; step <= options.steps && result.failedStep < 0; ++step) {
            const Action action = engine.Step();
            ++result.actions[action];
            result.stepsRun = step;
            result.digest = engine.Digest(result.digest, action);
            std::string violation = engine.Check();
            if (violation.empty() && options.extraCheck)
                violation = options.extraCheck(step);
            if (!violation.empty()) {
                result.failedStep = step;
                result.failedAction = NameOf(action);
                result.violation = violation;
                break;
            }
        }
        LARGE_INTEGER end;
        ::QueryPerformanceCounter(&end);
        result.seconds = Seconds(start, end);
        result.idleCensuses = engine.IdleCensuses();

        engine.DestroyAll();
        result.events = engine.GetEvents();
        result.after = TakeCensus(&engine.Ledger());
        if (result.after.gdiObjects != result.before.gdiObjects)
            result.newGdiObjects = engine.DescribeNewGdiObjects();
    }
    return result;
}

std::string Describe(const Result& result)
{
    std::ostringstream text;
    if (result.failedStep >= 0) {
        text << "seed " << result.seed << ", step " << result.failedStep << " (" << result.failedAction
             << "): " << result.violation;
        return text.str();
    }
    text << "seed " << result.seed << ": " << result.stepsRun << " steps in " << result.seconds << " s ("
         << (result.seconds > 0 ? result.stepsRun / result.seconds : 0.0) << " steps/s), " << result.idleCensuses
         << " idle censuses; at the start " << result.before << "; at the end " << result.after;
    if (result.before != result.after)
        text << " (LEAKED)";
    if (!result.newGdiObjects.empty())
        text << "; new GDI objects: " << result.newGdiObjects;
    return text.str();
}

} // namespace Soak
