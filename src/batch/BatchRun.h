#pragma once

#include "batch/BatchArguments.h"

namespace verbloom {

class BatchConsole;

/// Exit status of verbloom-batch.
inline constexpr int kExitSuccess = 0;
inline constexpr int kExitFailed = 1; ///< a check failed or a file could not be written
inline constexpr int kExitUsage = 2;  ///< the command line is wrong

/// The road of one article: the checks of the windows (nothing is written when one fails), the
/// analysis of "Next" with its word rows, the word files when looking up, then the action.
/// Returns the exit status; messages go to the console.
int RunBatch(const BatchArguments &arguments, BatchConsole &console);

} // namespace verbloom
