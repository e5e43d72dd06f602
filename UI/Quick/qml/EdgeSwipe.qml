import QtQuick
import Spectrel.Quick

// A swipe in from the left edge goes back, as the arrow does; drawn back to the edge before it ends, it does nothing.
// It lies beside what scrolls sideways; touches and vertical drags go through to what is below.
Item {
    id: edge

    readonly property real wanted: 72 // px
    property real pulled: 0
    readonly property bool isFar: pulled >= wanted

    signal swiped

    objectName: "edge"
    width: Theme.edge
    onEnabledChanged: pulled = 0

    DragHandler {
        target: null
        yAxis.enabled: false
        onActiveTranslationChanged: {
            if (active)
                edge.pulled = Math.max(0, activeTranslation.x);
        }
        onActiveChanged: {
            if (active)
                sign.y = centroid.position.y - sign.height / 2;
        }
        // The finger was lifted, or something else took it; the other of the two follows and finds nothing left to do.
        onGrabChanged: transition => {
            if (transition !== PointerDevice.UngrabExclusive && transition !== PointerDevice.CancelGrabExclusive)
                return;
            const goes = transition === PointerDevice.UngrabExclusive && edge.isFar;
            edge.pulled = 0;
            if (goes)
                edge.swiped();
        }
    }
    // Comes in with the finger, and is full once letting go would go back.
    Rectangle {
        id: sign
        objectName: "edgeSign"
        visible: edge.pulled > 0
        x: Math.min(edge.pulled / edge.wanted, 1) * (width + 12) - width
        width: 44
        height: width
        radius: width / 2
        color: edge.isFar ? Theme.accent : Theme.raised
        border.width: edge.isFar ? 0 : 1
        border.color: Theme.line

        Icon {
            anchors.centerIn: parent
            width: 24
            height: 24
            shape: Icon.Back
            color: edge.isFar ? Theme.accentText : Theme.accent
        }
    }
}
