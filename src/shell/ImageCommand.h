#pragma once

#include <QHash>
#include <QPixmap>
#include <QString>
#include <QWidget>

class QLabel;

namespace verbloom {

/// Twips of the original window layouts per pixel.
inline constexpr int TwipsPerPixel = 15;

/// Skin keys: the main window's commands, and the commands of the other windows.
inline const QString BlueSkin = QStringLiteral("button_blue");
inline const QString BlueHoverSkin = QStringLiteral("button_blue_hover");
inline const QString PicSkin = QStringLiteral("pic1");
inline const QString PicHoverSkin = QStringLiteral("pic2");

/// Pictures by key, like an image list ("button_blue", "button_blue_hover", "pic1", "pic2").
class ImageList final
{
public:
    /// The skins shipped in the resources.
    static const ImageList &Skins();
    void Add(const QString &key, const QPixmap &picture);
    QPixmap Picture(const QString &key) const;

private:
    QHash<QString, QPixmap> m_pictures;
};

/// A command: a transparent caption label laid over an image of the same size. Clicking either
/// emits clicked(); mouse moves over each part are reported separately, so the window decides
/// which image its hover table highlights. Both parts carry their own objectName.
class ImageCommand final : public QWidget
{
    Q_OBJECT

public:
    ImageCommand(const QString &labelName, const QString &imageName, const QString &caption,
                 const QString &normalSkin, QWidget *parent = nullptr);

    QLabel *Label() const { return m_label; }
    QLabel *Image() const { return m_image; }

    /// Takes the picture stored under the key; remembered so tests can read it back.
    void SetSkin(const QString &key);
    QString Skin() const { return m_skin; }
    /// The skin a mouse move over the caption or the image takes while that part is enabled;
    /// the window resets it. Without one, only the mouseMovedOver signals are emitted.
    void SetHoverSkin(const QString &key) { m_hoverSkin = key; }

    void SetCaption(const QString &caption);
    /// The same tool tip on the caption and the image.
    void SetToolTip(const QString &text);
    QString Caption() const;

signals:
    void clicked();
    void mouseMovedOverLabel();
    void mouseMovedOverImage();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    QLabel *m_image = nullptr;
    QLabel *m_label = nullptr;
    QString m_skin;
    QString m_hoverSkin;
};

} // namespace verbloom
