#include "platform/afx/core/detail/WindowSurface.h"

#include <QBackingStore>
#include <QGroupBox>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QPaintEngine>
#include <QPainter>
#include <QWindow>

#include <utility>

namespace tvx::afx {

namespace {

QHash<const QWidget*, WindowSurface*>& surfaces() {
    static QHash<const QWidget*, WindowSurface*> all;
    return all;
}

} // namespace

WindowSurface::WindowSurface(QWidget& window) : window_(window) {
    QObject::connect(&window, &QObject::destroyed, this, [this, key = &window] {
        surfaces().remove(key);
        delete this;
    });
}

WindowSurface& WindowSurface::of(const QWidget& widget) {
    QWidget* window = widget.window();
    WindowSurface*& surface = surfaces()[window];
    if (!surface) {
        surface = new WindowSurface(*window);
    }
    return *surface;
}

QImage* WindowSurface::storeImage() const {
    return dynamic_cast<QImage*>(store_->paintDevice());
}

bool WindowSurface::isDirect(const QImage* image) const {
    return image && image->depth() == 32 && image->devicePixelRatio() == 1 && window_.devicePixelRatio() == 1;
}

QImage* WindowSurface::open(const QRect& wanted) {
    QWindow* window = window_.windowHandle();
    store_ = window_.backingStore();
    if (!window || !store_ || !window_.isVisible() || store_->size().isEmpty()) {
        return nullptr;
    }
    // An empty region: the store is made ready for drawing (on some displays nothing is shown without), but nothing of
    // it is cleared.
    began_ = painting_ == 0;
    if (began_) {
        store_->beginPaint(QRegion());
    }
    QImage* image = storeImage();
    if (isDirect(image)) {
        alias_ = QImage(image->bits(), image->width(), image->height(), image->bytesPerLine(), QImage::Format_RGB32);
        return &alias_;
    }
    readCopy(image, wanted);
    return &copy_;
}

void WindowSurface::readCopy(const QImage* image, const QRect& wanted) {
    if (copy_.size() != window_.size()) {
        copy_ = QImage(window_.size(), QImage::Format_RGB32);
        copy_.fill(window_.palette().color(QPalette::Window));
    }
    if (!image) {
        return; // pixels that cannot be read: what was drawn last has to do
    }
    QPainter painter(&copy_);
    const double ratio = image->devicePixelRatio();
    painter.setCompositionMode(QPainter::CompositionMode_Source);
    painter.drawImage(QRectF(wanted), *image, QRectF(QPointF(wanted.topLeft()) * ratio, QSizeF(wanted.size()) * ratio));
}

void WindowSurface::writeCopy(const QRect& touched) {
    QPainter painter(store_->paintDevice());
    painter.drawImage(touched, copy_, touched);
}

void WindowSurface::close(const QRect& touched, ShownBy shownBy) {
    if (!touched.isEmpty()) {
        if (alias_.isNull()) {
            writeCopy(touched);
        }
        if (shownBy == ShownBy::flush) {
            showLater(touched);
        }
    }
    alias_ = QImage();
    if (began_) {
        store_->endPaint();
    }
    began_ = false;
}

/// A context that is kept open for longer shows its drawing when the program looks for the next message.
void WindowSurface::showLater(const QRect& part) {
    unshown_ |= part;
    if (std::exchange(flushIsPosted_, true)) {
        return;
    }
    const auto posted = [this] {
        flushIsPosted_ = false;
        flush();
    };
    QMetaObject::invokeMethod(this, posted, Qt::QueuedConnection);
}

void WindowSurface::endPaint() {
    if (--painting_ == 0 && !unshown_.isEmpty()) {
        showLater(QRect());
    }
}

void WindowSurface::flush() {
    if (painting_ > 0 || unshown_.isEmpty()) {
        return;
    }
    const QRect part = std::exchange(unshown_, QRect()) & window_.rect();
    QBackingStore* store = window_.backingStore();
    QWindow* window = window_.windowHandle();
    if (store && window && window_.isVisible() && !part.isEmpty()) {
        store->flush(part, window);
    }
}

namespace {

/// Group boxes stand around controls of the same dialog; what is inside of them is the dialog's.
bool keepsItsPixels(const QWidget& child, WindowPart part) {
    if (child.isHidden() || child.isWindow() || qobject_cast<const QGroupBox*>(&child)) {
        return false;
    }
    return part == WindowPart::client || !qobject_cast<const QMenuBar*>(&child);
}

void subtractChildren(QRegion& region, const QWidget& widget, WindowPart part) {
    for (const QObject* object : widget.children()) {
        const auto* child = qobject_cast<const QWidget*>(object);
        if (!child || !keepsItsPixels(*child, part)) {
            continue;
        }
        const QRegion mask = child->mask();
        region -= mask.isEmpty() ? QRegion(child->geometry()) : mask.translated(child->pos());
    }
}

/// Document windows overlap each other; the toolkit does not count those in front as covering what is behind.
void subtractDocumentsInFront(QRegion& region, const QWidget& widget) {
    for (const QWidget* level = &widget; level && !level->isWindow(); level = level->parentWidget()) {
        if (!qobject_cast<const QMdiSubWindow*>(level) || !level->parentWidget()) {
            continue;
        }
        const QObjectList& siblings = level->parentWidget()->children();
        for (auto i = siblings.indexOf(level) + 1; i < siblings.size(); ++i) {
            const auto* sibling = qobject_cast<const QMdiSubWindow*>(siblings[i]);
            if (sibling && !sibling->isHidden()) {
                region -= QRect(widget.mapFrom(level->parentWidget(), sibling->pos()), sibling->size());
            }
        }
    }
}

} // namespace

QRegion drawableRegion(const QWidget& widget, WindowPart part) {
    QRegion region = widget.visibleRegion();
    if (part == WindowPart::whole) {
        // The toolkit's visible region leaves opaque children out, the menu bar too.
        region = QRegion(widget.rect());
        for (const QWidget* level = &widget; !level->isWindow(); level = level->parentWidget()) {
            region &= QRect(widget.mapFrom(level->parentWidget(), QPoint()), level->parentWidget()->size());
        }
    }
    subtractChildren(region, widget, part);
    subtractDocumentsInFront(region, widget);
    return region;
}

// A window at any time

WindowTarget::WindowTarget(QWidget& widget, WindowPart part, std::function<QRect()> area)
    : widget_(&widget), part_(part), area_(std::move(area)) {}

bool WindowTarget::open(Canvas& canvas) {
    if (!widget_ || !widget_->isVisible()) {
        return false;
    }
    const QRect area = area_();
    if (!drawable_ || !layoutIsFixed) {
        drawable_ = drawableRegion(*widget_, part_) & area;
        if (limit) {
            *drawable_ &= *limit;
        }
    }
    const QRegion& clip = *drawable_;
    const QPoint widgetOrigin = widget_->mapTo(widget_->window(), QPoint());
    origin_ = widgetOrigin + area.topLeft();
    QImage* image = WindowSurface::of(*widget_).open(clip.boundingRect().translated(widgetOrigin));
    if (!image) {
        return false;
    }
    canvas.image = image;
    canvas.origin = origin_;
    canvas.clip = clip.translated(-area.topLeft()) & image->rect().translated(-origin_);
    return true;
}

void WindowTarget::close(const QRect& touched) {
    if (widget_) {
        WindowSurface::of(*widget_).close(touched.isEmpty() ? QRect() : touched.translated(origin_), shownBy);
    }
}

QSize WindowTarget::size() const {
    return widget_ ? area_().size() : QSize();
}

void WindowTarget::release() {
    if (widget_) {
        WindowSurface::of(*widget_).flush();
    }
}

// A paint event

PaintTarget::PaintTarget(QWidget& widget, const QRegion& update, std::function<QRect()> area)
    : widget_(&widget), update_(update), area_(area), window_(widget, WindowPart::client, std::move(area)) {
    window_.limit = update;
    if (!widget.testAttribute(Qt::WA_WState_InPaintEvent)) {
        return; // nothing is being painted: `update` limits what can be drawn
    }
    takePicture();
    if (!picture_.isNull()) {
        return;
    }
    surface_ = &WindowSurface::of(widget);
    surface_->beginPaint();
    window_.shownBy = WindowSurface::ShownBy::toolkit;
    window_.layoutIsFixed = true;
}

PaintTarget::~PaintTarget() {
    if (surface_) {
        surface_->endPaint();
    }
}

/// Finds out whether the widget is being painted on anything but its window, and takes what is there so far.
void PaintTarget::takePicture() {
    QPainter painter(widget_);
    QPaintDevice* device = painter.paintEngine() ? painter.paintEngine()->paintDevice() : nullptr;
    QBackingStore* store = widget_->backingStore();
    if (!device || (store && device == store->paintDevice())) {
        return;
    }
    picture_ = QImage(widget_->size(), QImage::Format_RGB32);
    picture_.fill(widget_->palette().color(widget_->backgroundRole()));
    const QPoint place = painter.deviceTransform().map(QPoint());
    QPainter copier(&picture_);
    if (const auto* pixmap = dynamic_cast<QPixmap*>(device)) {
        copier.drawPixmap(-place, *pixmap);
    } else if (const auto* image = dynamic_cast<QImage*>(device)) {
        copier.drawImage(-place, *image);
    }
}

bool PaintTarget::open(Canvas& canvas) {
    if (picture_.isNull()) {
        return window_.open(canvas);
    }
    const QRect area = area_();
    canvas.image = &picture_;
    canvas.origin = area.topLeft();
    canvas.clip = (update_ & area & picture_.rect()).translated(-area.topLeft());
    return true;
}

void PaintTarget::close(const QRect& touched) {
    if (picture_.isNull()) {
        window_.close(touched);
    } else if (!touched.isEmpty()) {
        drawn_ |= touched.translated(area_().topLeft());
    }
}

QSize PaintTarget::size() const {
    return window_.size();
}

void PaintTarget::release() {
    if (!picture_.isNull() && widget_ && !drawn_.isEmpty()) {
        QPainter painter(widget_);
        painter.setClipRegion(update_);
        painter.drawImage(drawn_, picture_, drawn_);
    }
    window_.release();
}

} // namespace tvx::afx
