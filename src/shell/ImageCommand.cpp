#include "ImageCommand.h"

#include <QEvent>
#include <QLabel>
#include <QMouseEvent>
#include <QPainter>
#include <QStyle>

namespace verbloom {

namespace {

// The caption leaves a thin margin of the image free, so the skin can be pointed at around it.
constexpr int CaptionInset = 3;
constexpr QSize DefaultCommandSize(113, 28);

// The caption keeps its text exactly (leading blanks included) but is drawn without the
// blanks, centred on the skin and cut with "..." when it does not fit.
class CaptionLabel final : public QLabel
{
public:
    using QLabel::QLabel;

protected:
    void paintEvent(QPaintEvent *) override
    {
        QPainter painter(this);
        drawFrame(&painter);
        const QRect area = contentsRect();
        const QString shown = fontMetrics().elidedText(text().trimmed(), Qt::ElideRight, area.width());
        style()->drawItemText(&painter, area, Qt::AlignCenter, palette(), isEnabled(), shown,
                              foregroundRole());
    }
};

ImageList LoadSkins()
{
    ImageList list;
    for (const QString &key : {BlueSkin, BlueHoverSkin, PicSkin, PicHoverSkin})
        list.Add(key, QPixmap(QStringLiteral(":/skins/") + key + QStringLiteral(".png")));
    return list;
}

} // namespace

const ImageList &ImageList::Skins()
{
    static const ImageList skins = LoadSkins();
    return skins;
}

void ImageList::Add(const QString &key, const QPixmap &picture)
{
    m_pictures.insert(key, picture);
}

QPixmap ImageList::Picture(const QString &key) const
{
    return m_pictures.value(key);
}

ImageCommand::ImageCommand(const QString &labelName, const QString &imageName, const QString &caption,
                           const QString &normalSkin, QWidget *parent)
    : QWidget(parent)
    , m_image(new QLabel(this))
    , m_label(new CaptionLabel(caption, this))
{
    m_image->setObjectName(imageName);
    m_image->setScaledContents(true);
    m_label->setObjectName(labelName);
    m_label->setAttribute(Qt::WA_TranslucentBackground);
    m_label->setStyleSheet(QStringLiteral("QLabel { color: white; font-weight: 600; background: transparent; }"
                                          "QLabel:disabled { color: rgba(255, 255, 255, 110); }"));
    for (QLabel *part : {m_image, m_label}) {
        part->setMouseTracking(true);
        part->setCursor(Qt::PointingHandCursor);
        part->installEventFilter(this);
    }
    setMouseTracking(true);
    installEventFilter(this);
    setFixedSize(DefaultCommandSize);
    SetSkin(normalSkin);
}

void ImageCommand::SetSkin(const QString &key)
{
    m_skin = key;
    m_image->setPixmap(ImageList::Skins().Picture(key));
}

void ImageCommand::SetToolTip(const QString &text)
{
    m_label->setToolTip(text);
    m_image->setToolTip(text);
}

void ImageCommand::SetCaption(const QString &caption)
{
    m_label->setText(caption);
}

QString ImageCommand::Caption() const
{
    return m_label->text();
}

bool ImageCommand::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == this) {
        if (event->type() == QEvent::Resize) {
            m_image->setGeometry(rect());
            m_label->setGeometry(rect().adjusted(CaptionInset, CaptionInset, -CaptionInset, -CaptionInset));
        }
        return QWidget::eventFilter(watched, event);
    }
    if (watched != m_label && watched != m_image)
        return QWidget::eventFilter(watched, event);
    auto *part = static_cast<QWidget *>(watched);
    switch (event->type()) {
    case QEvent::MouseMove:
        if (part->isEnabled()) {
            if (!m_hoverSkin.isEmpty())
                SetSkin(m_hoverSkin);
            if (watched == m_label)
                emit mouseMovedOverLabel();
            else
                emit mouseMovedOverImage();
        }
        return true;
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonDblClick:
        return true;
    case QEvent::MouseButtonRelease: {
        const auto *mouse = static_cast<QMouseEvent *>(event);
        if (part->isEnabled() && mouse->button() == Qt::LeftButton
            && part->rect().contains(mouse->position().toPoint()))
            emit clicked();
        return true;
    }
    default:
        break;
    }
    return QWidget::eventFilter(watched, event);
}

} // namespace verbloom
