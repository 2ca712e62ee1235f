#pragma once

#include <QString>

namespace verbloom {

/// Every LF becomes CR LF (for texts whose line breaks are single LFs).
QString LfToCrLf(QString text);

/// Every line break (CR LF or lone CR) becomes a single LF.
QString NormalizeToLf(QString text);

/// Every line break (CR LF, lone CR or lone LF) becomes CR LF, as the files of the program
/// and a multi-line text box hold them.
QString NormalizeToCrLf(QString text);

} // namespace verbloom
