#pragma once

#include "Platform/ScreenToolkit.h"
#include "UI/Quick/PaneModel.h"
#include "UI/Quick/SaveModel.h"

#include <QObject>
#include <QSizeF>
#include <QString>
#include <QtQml/qqmlregistration.h>
#include <deque>
#include <functional>
#include <vector>

namespace spectrel {

class SpectrelApp;

/// The toolkit of the graphical screens: measures texts with the desktop's fonts and tells the QML what has changed.
///
/// The shared application's controllers are the only state; the models in here are what the QML knows of them.
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

public:
    explicit QuickScreen(std::function<void()> quit);

    // For the controllers.
    Size sizeOfText(std::string_view text, const Font& font) const override;
    Size mainScreenSize() const override;
    void screenDidChange(ScreenPart part, Animation animation) override;
    void showAlert(const Alert& alert) override;

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

    /// The QML is there: it is told of every pane that is open already.
    Q_INVOKABLE void begin(double width, double height);
    Q_INVOKABLE void resize(double width, double height);
    /// The back arrow: closes the top pane.
    Q_INVOKABLE void back();
    Q_INVOKABLE void closeAlert();
    Q_INVOKABLE void quit();

signals:
    void windowShownChanged();
    void isDarkChanged();
    void saveScreenChanged();
    void alertChanged();
    /// A pane came to the top, or all but the lowest `count` have gone.
    void pushed(spectrel::PaneModel* pane, bool isAnimated);
    void popped(int count, bool isAnimated);

private:
    void adoptPanes(Animation animation);
    void adoptSaveScreen();
    template <typename Member> void tellPanes(Member member);

    std::function<void()> _quit;
    Size _size {480, 800};
    bool _isReady = false;
    bool _isDark = false;
    std::vector<PaneModel*> _panes; // of the stack, bottom first; the models are this object's children
    SaveModel* _saveScreen = nullptr;
    std::deque<Alert> _alerts;
};

} // namespace spectrel
