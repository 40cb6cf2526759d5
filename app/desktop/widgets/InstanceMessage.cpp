#include "InstanceMessage.h"

#include <QStringDecoder>
#include <QtEndian>

namespace gw {

namespace {

constexpr char kLetters[] = {'G', 'W', 'R', '1'};
constexpr qsizetype kLetterCount = sizeof kLetters;

bool IsPath(QByteArrayView path)
{
    QStringDecoder decoder(QStringDecoder::Utf8);
    const QString text = decoder.decode(path);
    return !decoder.hasError() && !text.contains(QChar::Null);
}

} // namespace

QByteArray MakeMessage(const std::string& path)
{
    const bool fits = path.size() <= size_t{kLongestPath};
    const QByteArray bytes = fits ? QByteArray::fromStdString(path) : QByteArray();
    char head[kMessageHead];
    std::copy_n(kLetters, kLetterCount, head);
    qToLittleEndian(static_cast<quint32>(bytes.size()), head + kLetterCount);
    return QByteArray(head, kMessageHead) + bytes;
}

EMessageState ReadMessage(const QByteArray& bytes, std::string& path)
{
    const qsizetype letters = std::min(bytes.size(), kLetterCount);
    if (!std::equal(kLetters, kLetters + letters, bytes.begin()))
        return EMessageState::Wrong;
    if (bytes.size() < kMessageHead)
        return EMessageState::Partial;
    const qsizetype length = qFromLittleEndian<quint32>(bytes.constData() + kLetterCount);
    const QByteArrayView rest = QByteArrayView(bytes).sliced(kMessageHead);
    if (length > kLongestPath || rest.size() > length)
        return EMessageState::Wrong;
    if (rest.size() < length)
        return EMessageState::Partial;
    if (!IsPath(rest))
        return EMessageState::Wrong;
    path.assign(rest.data(), static_cast<size_t>(rest.size()));
    return EMessageState::Whole;
}

} // namespace gw
