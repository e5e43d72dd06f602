#include "UI/Quick/KeyMap.h"

#include <QKeySequence>

namespace spectrel {

QString KeyMap::nameOf(int key, int modifiers, const QString& text)
{
    const bool isCombined = modifiers & int(Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier);
    if (!isCombined && text.size() == 1 && text.front().isPrint() && text != QLatin1String(" "))
        return text;
    const int held = isCombined ? modifiers & ~int(Qt::KeypadModifier) : 0;
    return QKeySequence(key | held).toString(QKeySequence::PortableText);
}

int KeyMap::actionOf(const QString& key)
{
    const auto action = spectrel::actionOf(key.toStdString(), KeyTaker::Window, KeyScope::Browsing);
    return action ? static_cast<int>(*action) : -1;
}

QStringList KeyMap::sequences(int action)
{
    QStringList keys;
    for (const std::string_view key : windowKeys(static_cast<KeyAction>(action)))
        keys.append(QString::fromUtf8(key.data(), static_cast<qsizetype>(key.size())));
    return keys;
}

} // namespace spectrel
