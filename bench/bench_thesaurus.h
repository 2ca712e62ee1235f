#pragma once

#include <QTextStream>

namespace verbloom::bench {

/// Thesaurus lookups per second over loopback against the embedded service.
void RunThesaurusBenchmarks(QTextStream &out);

} // namespace verbloom::bench
