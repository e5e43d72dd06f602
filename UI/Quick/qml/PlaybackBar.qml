import QtQuick
import QtQuick.Layouts
import QtQuick.Templates as T
import Spectrel.Quick

// A recording's time line: where the screens stand in it, and the buttons that move them.
Rectangle {
    id: bar

    required property PlaybackModel playback

    implicitHeight: 118
    color: Theme.surface

    component BarButton: IconButton {
        Layout.fillWidth: true // they share the width of a window too narrow for all
        Layout.preferredWidth: 1
        size: 20
    }

    Rectangle {
        width: parent.width
        height: 1
        color: Theme.line
    }
    RowLayout {
        id: texts
        x: 20
        y: 10
        width: parent.width - 40

        Text {
            objectName: "playbackTime"
            text: bar.playback.timeText
            font.pixelSize: Theme.noteText
            color: Theme.text
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }
        Text {
            objectName: "playbackMessages"
            visible: bar.width >= 420
            Layout.fillWidth: true
            text: bar.playback.messagesText
            font.pixelSize: Theme.noteText
            color: Theme.faint
            elide: Text.ElideRight
            horizontalAlignment: Text.AlignHCenter
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }
        Item {
            visible: bar.width < 420
            Layout.fillWidth: true
        }
        Text {
            objectName: "playbackState"
            text: bar.playback.stateText
            font.pixelSize: Theme.noteText
            font.bold: true
            color: Theme.accent
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }
    }
    T.Slider {
        id: line
        objectName: "playbackLine"
        anchors.top: texts.bottom
        x: 12
        width: parent.width - 24
        height: 44
        focusPolicy: Qt.TabFocus
        value: bar.playback.fraction
        stepSize: 0
        live: true
        onMoved: bar.playback.seekToFraction(value)
        // A drag has cut the line off from the playback.
        onPressedChanged: {
            if (!pressed)
                value = Qt.binding(() => bar.playback.fraction);
        }
        Accessible.role: Accessible.Slider
        Accessible.name: qsTr("Time line")

        background: Rectangle {
            x: 8
            y: (parent.height - height) / 2
            width: parent.width - 16
            height: 4
            radius: 2
            color: Theme.line

            Rectangle {
                width: line.visualPosition * parent.width
                height: parent.height
                radius: 2
                color: Theme.accent
            }
        }
        handle: Rectangle {
            x: line.visualPosition * (line.width - 16)
            y: (line.height - height) / 2
            width: 16
            height: 16
            radius: 8
            color: Theme.accent
            border.width: line.visualFocus ? 3 : 0
            border.color: Theme.text
        }
    }
    RowLayout {
        anchors.bottom: parent.bottom
        anchors.horizontalCenter: parent.horizontalCenter
        width: Math.min(parent.width, 7 * Theme.touch)
        height: Theme.touch
        spacing: 0

        BarButton {
            objectName: "slower"
            shape: Icon.Minus
            text: qsTr("Slower")
            onClicked: bar.playback.changeSpeed(-1)
        }
        BarButton {
            objectName: "seekBack"
            shape: Icon.SkipBack
            text: qsTr("Ten seconds back")
            onClicked: bar.playback.seekStep(-1)
        }
        BarButton {
            objectName: "stepBack"
            shape: Icon.StepBack
            text: qsTr("One message back")
            onClicked: bar.playback.stepMessage(-1)
        }
        BarButton {
            objectName: "play"
            shape: bar.playback.isPlaying ? Icon.Pause : Icon.Play
            size: 26
            text: bar.playback.isPlaying ? qsTr("Pause") : qsTr("Play")
            onClicked: bar.playback.togglePlaying()
        }
        BarButton {
            objectName: "stepForward"
            shape: Icon.StepForward
            text: qsTr("One message on")
            onClicked: bar.playback.stepMessage(1)
        }
        BarButton {
            objectName: "seekForward"
            shape: Icon.SkipForward
            text: qsTr("Ten seconds on")
            onClicked: bar.playback.seekStep(1)
        }
        BarButton {
            objectName: "faster"
            shape: Icon.Plus
            text: qsTr("Faster")
            onClicked: bar.playback.changeSpeed(1)
        }
    }
}
