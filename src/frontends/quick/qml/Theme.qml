// Every colour and measure of the window, in light and in dark.
pragma Singleton

import QtQuick

QtObject {
    property bool dark: false
    property real textScale: 1

    // Surfaces, from the back to the front.
    readonly property color window: dark ? "#131417" : "#f3f1ec"
    readonly property color bar: dark ? "#0c0d0f" : "#e9e6de"
    readonly property color card: dark ? "#1e2025" : "#ffffff"
    readonly property color line: dark ? "#30333a" : "#e4e0d7"
    readonly property color border: dark ? "#7c818c" : "#8a8578"
    readonly property color hovered: dark ? "#25282e" : "#faf8f3"
    readonly property color pressed: dark ? "#2d3037" : "#efebe1"
    readonly property color changed: dark ? "#463812" : "#ffedba"

    // The colours on these surfaces.
    readonly property color text: dark ? "#f2f1ed" : "#1c1b18"
    readonly property color secondaryText: dark ? "#aeb2bb" : "#5f5b52"
    readonly property color accentText: dark ? "#ffcb52" : "#7a5000"
    readonly property color goodText: dark ? "#6fd892" : "#1b6e37"
    readonly property color playbackText: dark ? "#8cc4ff" : "#0b559f"
    readonly property color simulatedText: dark ? "#d9b0ff" : "#75349f"
    readonly property color badText: dark ? "#ff9d94" : "#b3261e"

    // The colour of the wasp: the selection, and the text on it.
    readonly property color accent: "#ffc233"
    readonly property color accentInk: "#241a00"
    // A short message above everything.
    readonly property color toast: dark ? "#f2f1ed" : "#2b2a26"
    readonly property color toastInk: dark ? "#1c1b18" : "#f7f5f0"

    // Text sizes and distances in device-independent pixels.
    readonly property int bodySize: scaled(15)
    readonly property int smallSize: scaled(12.5)
    readonly property int titleSize: scaled(20)
    readonly property int gap: 8
    readonly property int gutter: 12
    readonly property int padding: 16
    readonly property int radius: 12
    // Touch targets are never smaller than this, whatever the text size.
    readonly property int target: Math.max(48, scaled(44))
    // Beyond this a label and its value would be too far apart.
    readonly property int widest: scaled(760)
    readonly property int pageDuration: 220
    readonly property int markDuration: 300

    function scaled(size: real): int {
        return Math.round(size * textScale);
    }
}
