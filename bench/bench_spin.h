#pragma once

class QTextStream;

namespace verbloom::bench {

/// Spin throughput of a 1,000-word article at "Maximum" and "Level 2": inside one run (word
/// files read once) and as separate spins (files read afresh), plus 10,000 versions in one run.
void RunSpinBenchmarks(QTextStream &out);

} // namespace verbloom::bench
