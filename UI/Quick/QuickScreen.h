#pragma once

#include "UI/Quick/FindModel.h"
#include "UI/Quick/PaneModel.h"
#include "UI/Quick/PlaybackModel.h"
#include "UI/Quick/SaveModel.h"
#include "UI/ScreenToolkit.h"

#include <QObject>
#include <QSizeF>
#include <QString>
#include <QtQml/qqmlregistration.h>
#include <deque>
#include <functional>
#include <vector>

namespace spectrel {

/// The toolkit of the graphical screens: measures texts with the desktop's fonts and informs the QML of changes.
///
/// The application's controllers are the only state; the models in here are what the QML knows of them.
class QuickScreen final : public QObject, public ScreenToolkit {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("there is one screen")
    Q_PROPERTY(bool isWindowShown READ isWindowShown NOTIFY windowShownChanged)
    Q_PROPERTY(bool isDark READ isDark NOTIFY isDarkChanged)
    Q_PROPERTY(spectrel::SaveModel* saveScreen READ saveScreen NOTIFY saveScreenChanged)
    Q_PROPERTY(bool hasAlert READ hasAlert NOTIFY alertChanged)
    Q_PROPERTY(QString alertTitle READ alertTitle NOTIFY alertChanged)
    Q_PROPERTY(QString alertMessage READ alertMessage NOTIFY alertChanged)
    Q_PROPERTY(QString alertButton READ alertButton NOTIFY alertChanged)
    Q_PROPERTY(QString notice READ notice NOTIFY noticeChanged)
    Q_PROPERTY(spectrel::FindModel* find READ find CONSTANT)
    Q_PROPERTY(spectrel::PlaybackModel* playback READ playback CONSTANT)
    Q_PROPERTY(QString aboutName READ aboutName CONSTANT)
    Q_PROPERTY(QString aboutVersion READ aboutVersion CONSTANT)
    Q_PROPERTY(QString aboutSummary READ aboutSummary CONSTANT)

public:
    explicit QuickScreen(std::function<void()> quit);

    // For the controllers.
    Size sizeOfText(std::string_view text, const Font& font) const override;
    Size mainScreenSize() const override;
    void screenDidChange(ScreenPart part, Animation animation) override;
    void showAlert(const Alert& alert) override;
    Outcome copyToClipboard(const std::string& text) override;

    // For the front end.
    void setDark(bool isDark);

    // For the QML.
    bool isWindowShown() const;
    bool isDark() const
    {
        return _isDark;
    }
    SaveModel* saveScreen() const
    {
        return _saveScreen;
    }
    bool hasAlert() const
    {
        return !_alerts.empty();
    }
    QString alertTitle() const;
    QString alertMessage() const;
    QString alertButton() const;
    /// A short message that goes by itself: what became of a copy, or what went wrong in a recording.
    QString notice() const;
    FindModel* find()
    {
        return &_find;
    }
    PlaybackModel* playback()
    {
        return &_playback;
    }
    static QString aboutName();
    static QString aboutVersion();
    static QString aboutSummary();

    /// The QML is there: it hears of every pane that is open already.
    Q_INVOKABLE void begin(double width, double height);
    Q_INVOKABLE void resize(double width, double height);
    Q_INVOKABLE void closeAlert();
    /// A row of the top pane, or all of them, onto the clipboard.
    Q_INVOKABLE void copyRow(int row);
    Q_INVOKABLE void copyPane();
    /// The notice was shown long enough.
    Q_INVOKABLE void clearNotice();
    Q_INVOKABLE void quit();

signals:
    void windowShownChanged();
    void isDarkChanged();
    void saveScreenChanged();
    void alertChanged();
    void noticeChanged();
    /// A pane came to the top, or all but the lowest `count` have gone.
    void pushed(spectrel::PaneModel* pane, bool isAnimated);
    void popped(int count, bool isAnimated);

private:
    void adoptPanes(Animation animation);
    void adoptSaveScreen();
    template <typename Member> void forEachPane(Member member);

    std::function<void()> _quit;
    Size _size {480, 800};
    bool _isReady = false;
    bool _isDark = false;
    std::vector<PaneModel*> _panes; // of the stack, bottom first; the models are this object's children
    SaveModel* _saveScreen = nullptr;
    std::deque<Alert> _alerts;
    FindModel _find {*this};
    PlaybackModel _playback {*this};
};

} // namespace spectrel
