import QtQuick
import Spectrel.Quick

// The loading indicator: hidden when stopped, and turning only while it is in sight.
Item {
    id: spinner

    property bool running: false

    visible: running
    implicitWidth: running ? 18 : 0
    implicitHeight: 18
    Accessible.role: Accessible.Indicator
    Accessible.name: qsTr("Loading")

    Icon {
        id: arc
        anchors.centerIn: parent
        width: 18
        height: 18
        shape: Icon.Arc
        color: Theme.faint

        RotationAnimator on rotation {
            from: 0
            to: 360
            duration: 900
            loops: Animation.Infinite
            running: spinner.running && spinner.Window.visibility !== Window.Hidden
        }
    }
}
