#pragma once

class QTextStream;

namespace verbloom::bench {

/// SQL export of 10,000 versions and a site of 1,000 pages (10 links per page) from a 1,000-word
/// article with the real spin generator: seconds and peak memory of each.
void RunExportBenchmarks(QTextStream &out);

} // namespace verbloom::bench
