#include "frontends/quick/Appearance.h"

#include <QDBusError>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QGuiApplication>
#include <QPalette>
#include <algorithm>
#include <cmath>

#include "platform/log/Log.h"

namespace vespscope::quick {
namespace {

// The desktop portal's settings, available on every desktop with a portal.
constexpr auto service = "org.freedesktop.portal.Desktop";
constexpr auto path = "/org/freedesktop/portal/desktop";
constexpr auto interface = "org.freedesktop.portal.Settings";
constexpr auto appearanceGroup = "org.freedesktop.appearance";
constexpr auto colourKey = "color-scheme";  // 0 no preference, 1 dark, 2 light
constexpr auto textGroup = "org.gnome.desktop.interface";
constexpr auto textKey = "text-scaling-factor";

bool hasDarkPalette() { return QGuiApplication::palette().color(QPalette::Window).lightness() < 128; }

}  // namespace

Appearance::Appearance(QObject* parent) : QObject(parent), systemDark_(hasDarkPalette()) {}

void Appearance::followDesktop(const QDBusConnection& desktop) {
  QDBusConnection bus = desktop;
  if (!bus.isConnected()) return;
  // The slot's parameters are looked up by their type names; this registers them.
  qRegisterMetaType<QDBusVariant>();
  const bool connected =
      bus.connect(QLatin1String(service), QLatin1String(path), QLatin1String(interface),
                  QStringLiteral("SettingChanged"), this, SLOT(hear(QString, QString, QDBusVariant)));
  if (!connected)
    log::system("changes of the desktop's appearance are not followed: " + bus.lastError().message().toStdString());
  ask(bus, QLatin1String(appearanceGroup), QLatin1String(colourKey));
  ask(bus, QLatin1String(textGroup), QLatin1String(textKey));
}

void Appearance::ask(const QDBusConnection& desktop, const QString& group, const QString& key) {
  QDBusMessage call = QDBusMessage::createMethodCall(QLatin1String(service), QLatin1String(path),
                                                     QLatin1String(interface), QStringLiteral("Read"));
  call.setArguments({group, key});
  auto* answer = new QDBusPendingCallWatcher(desktop.asyncCall(call), this);
  connect(answer, &QDBusPendingCallWatcher::finished, this, [this, group, key](QDBusPendingCallWatcher* finished) {
    const QDBusPendingReply<QVariant> reply = *finished;
    if (reply.isValid()) settingChanged(group, key, reply.value());
    finished->deleteLater();
  });
}

void Appearance::hear(const QString& group, const QString& key, const QDBusVariant& value) {
  settingChanged(group, key, value.variant());
}

void Appearance::settingChanged(const QString& group, const QString& key, const QVariant& value) {
  QVariant plain = value;
  while (plain.canConvert<QDBusVariant>()) plain = plain.value<QDBusVariant>().variant();
  if (group == QLatin1String(appearanceGroup) && key == QLatin1String(colourKey)) {
    const uint preference = plain.toUInt();
    systemDark_ = preference == 0 ? hasDarkPalette() : preference == 1;
    emit changed();
  } else if (group == QLatin1String(textGroup) && key == QLatin1String(textKey)) {
    const double scale = plain.toDouble();
    if (!(scale > 0)) return;
    const bool followed = textScale_ == systemTextScale_;
    systemTextScale_ = std::clamp(scale, smallestTextScale, largestTextScale);
    if (followed) setTextScale(systemTextScale_);
  }
}

void Appearance::setMode(Mode mode) {
  if (mode == mode_) return;
  mode_ = mode;
  emit changed();
}

bool Appearance::dark() const { return mode_ == Mode::System ? systemDark_ : mode_ == Mode::Dark; }

void Appearance::setTextScale(double scale) {
  textScale_ = std::clamp(scale, smallestTextScale, largestTextScale);
  emit changed();
}

void Appearance::toggle() { setMode(dark() ? Mode::Light : Mode::Dark); }

void Appearance::zoom(int steps) {
  setTextScale(steps == 0 ? systemTextScale_ : std::round(textScale_ * 8 + steps) / 8);
}

}  // namespace vespscope::quick
