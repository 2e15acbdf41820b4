#include "platform/user/text.h"

#include "platform/gdi/encoding.h"
#include "platform/kernel/text.h"
#include "platform/user.h"

#include <QStringDecoder>

namespace seam {

QString shownText(const std::string& bytes) {
    const auto size = static_cast<qsizetype>(bytes.size());
    QStringDecoder decode(QStringDecoder::Utf8, QStringConverter::Flag::Stateless);
    const QString text = decode(QByteArrayView(bytes.data(), size));
    return decode.hasError() ? fromWindows1252(bytes.data(), bytes.size()) : text;
}

} // namespace seam

char* CharLowerA(char* text) {
    const std::string lower = seam::lowered(text);
    std::copy(lower.begin(), lower.end(), text);
    return text;
}
