#pragma once

#include <QObject>
#include <QString>
#include <QtQml/qqmlregistration.h>

namespace spectrel {

class PlaybackController;
class ScreenToolkit;

/// The playback line of a recording as the QML sees it.
class PlaybackModel final : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("the playback comes from the screen")
    Q_PROPERTY(bool isThere READ isThere NOTIFY changed)
    Q_PROPERTY(bool isPlaying READ isPlaying NOTIFY changed)
    Q_PROPERTY(double fraction READ fraction NOTIFY changed)
    Q_PROPERTY(QString stateText READ stateText NOTIFY changed)
    Q_PROPERTY(QString timeText READ timeText NOTIFY changed)
    Q_PROPERTY(QString messagesText READ messagesText NOTIFY changed)

public:
    /// `toolkit` knows the application and outlives this.
    explicit PlaybackModel(const ScreenToolkit& toolkit)
        : _toolkit(toolkit)
    {
    }

    /// Something is played.
    bool isThere() const;
    bool isPlaying() const;
    double fraction() const;
    QString stateText() const;
    QString timeText() const;
    QString messagesText() const;

    /// A key of the time line; false when it is none, or nothing is played.
    Q_INVOKABLE bool press(const QString& key);
    // `by` is -1 or 1.
    Q_INVOKABLE void togglePlaying();
    Q_INVOKABLE void stepMessage(int by);
    Q_INVOKABLE void seekStep(int by);
    Q_INVOKABLE void seekToFraction(double fraction);
    Q_INVOKABLE void changeSpeed(int by);

signals:
    void changed();

private:
    PlaybackController* controller() const;

    const ScreenToolkit& _toolkit;
};

} // namespace spectrel
