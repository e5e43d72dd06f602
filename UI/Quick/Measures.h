#pragma once

#include <QFont>
#include <QObject>
#include <QtQml/qqmlregistration.h>

namespace spectrel {

/// The sizes and fonts by which the controllers place what they show, for the QML that draws it.
class Measures final : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_SINGLETON
    Q_PROPERTY(double rowHeight READ rowHeight CONSTANT)
    Q_PROPERTY(double entryHeight READ entryHeight CONSTANT)
    Q_PROPERTY(QFont nameFont READ nameFont CONSTANT)
    Q_PROPERTY(QFont valueFont READ valueFont CONSTANT)
    Q_PROPERTY(QFont statusFont READ statusFont CONSTANT)
    Q_PROPERTY(QFont entryFont READ entryFont CONSTANT)

public:
    static double rowHeight();
    static double entryHeight();
    static QFont nameFont();
    static QFont valueFont();
    static QFont statusFont();
    static QFont entryFont();
};

} // namespace spectrel
