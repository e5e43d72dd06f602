import QtQuick
import QtQuick.Controls.Basic
import Spectrel.Quick

// The window: the stack of panes, and what comes up over it.
ApplicationWindow {
    id: window

    required property QuickScreen screen

    width: 480
    height: 800
    minimumWidth: 280
    minimumHeight: 320
    visible: screen.isWindowShown
    title: stack.currentItem?.pane.title ?? "Spectrel"
    color: Theme.background
    palette.window: Theme.background
    palette.windowText: Theme.text
    palette.base: Theme.surface
    palette.text: Theme.text
    palette.button: Theme.surface
    palette.buttonText: Theme.text
    palette.highlight: Theme.accent
    palette.highlightedText: Theme.accentText
    palette.mid: Theme.faint
    palette.dark: Theme.faint

    onWidthChanged: screen.resize(width, height)
    onHeightChanged: screen.resize(width, height)
    onClosing: close => {
        close.accepted = false; // the application hides the window once it has been shut down
        screen.quit();
    }
    Component.onCompleted: screen.begin(width, height)

    Binding {
        target: Theme
        property: "isDark"
        value: window.screen.isDark
    }

    StackView {
        id: stack
        objectName: "stack"
        anchors.top: parent.top
        anchors.bottom: playbackBar.visible ? playbackBar.top : parent.bottom
        width: parent.width
        focus: true

        pushEnter: Transition {
            XAnimator { from: stack.width; to: 0; duration: Theme.slide; easing.type: Easing.OutCubic }
        }
        pushExit: Transition {
            XAnimator { from: 0; to: -stack.width / 3; duration: Theme.slide; easing.type: Easing.OutCubic }
        }
        popEnter: Transition {
            XAnimator { from: -stack.width / 3; to: 0; duration: Theme.slide; easing.type: Easing.OutCubic }
        }
        popExit: Transition {
            XAnimator { from: 0; to: stack.width; duration: Theme.slide; easing.type: Easing.OutCubic }
        }
    }
    Component {
        id: panePage
        PanePage {
            onAboutPressed: aboutBox.open()
        }
    }
    PlaybackBar {
        id: playbackBar
        anchors.bottom: parent.bottom
        width: parent.width
        visible: playback.isThere
        playback: window.screen.playback
    }
    Toast {
        anchors.horizontalCenter: parent.horizontalCenter
        anchors.bottom: stack.bottom
        anchors.bottomMargin: 72
        z: 1
        screen: window.screen
    }
    FindSheet { find: window.screen.find }
    AboutBox {
        id: aboutBox
        screen: window.screen
    }
    SaveSheet { id: saveSheet }
    AlertBox { screen: window.screen }

    Shortcut {
        sequences: KeyMap.sequences(KeyMap.Save)
        onActivated: stack.currentItem?.pane.pressSaveButton()
    }
    Shortcut {
        sequences: KeyMap.sequences(KeyMap.Find)
        enabled: !window.screen.saveScreen
        onActivated: window.screen.find.open()
    }
    Shortcut {
        sequences: KeyMap.sequences(KeyMap.FindNext)
        onActivated: window.screen.find.chooseNext()
    }
    Shortcut {
        sequences: KeyMap.sequences(KeyMap.FindPrevious)
        onActivated: window.screen.find.choosePrevious()
    }
    Shortcut {
        sequences: KeyMap.sequences(KeyMap.Quit)
        onActivated: window.screen.quit()
    }

    Connections {
        target: window.screen
        function onPushed(pane, isAnimated) {
            stack.push(panePage, { pane: pane, screen: window.screen },
                       isAnimated ? StackView.PushTransition : StackView.Immediate);
            stack.currentItem.forceActiveFocus();
        }
        function onPopped(count, isAnimated) {
            stack.pop(count > 0 ? stack.get(count - 1, StackView.DontLoad) : null,
                      isAnimated ? StackView.PopTransition : StackView.Immediate);
            stack.currentItem.forceActiveFocus();
        }
        function onSaveScreenChanged() {
            if (window.screen.saveScreen)
                saveSheet.present(window.screen.saveScreen);
            else
                saveSheet.close();
        }
    }
}
