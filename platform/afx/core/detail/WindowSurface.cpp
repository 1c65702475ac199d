#include "platform/afx/core/detail/WindowSurface.h"
#include "platform/afx/core/detail/BrokenPixels.h"
#include "platform/afx/core/detail/Connect.h"

#include <QBackingStore>
#include <QGroupBox>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QPaintEngine>
#include <QPainter>
#include <QWindow>

#include <cmath>
#include <utility>

namespace tvx::afx {

namespace {

QHash<const QWidget*, WindowSurface*>& surfaces() {
    static QHash<const QWidget*, WindowSurface*> all;
    return all;
}

} // namespace

namespace {

QImage* imageOf(QBackingStore& store) {
    return dynamic_cast<QImage*>(store.paintDevice());
}

/// A store's pixels as one image in which a pixel is a unit.
QImage plainAlias(QImage& image, QImage::Format format) {
    return {image.bits(), image.width(), image.height(), image.bytesPerLine(), format};
}

} // namespace

WindowSurface::WindowSurface(QWidget& window) : m_window(window) {
    connectStoring(&window, &QObject::destroyed, this, [this, key = &window] {
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

QImage* WindowSurface::open(const QRect& wanted) {
    QWindow* window = m_window.windowHandle();
    m_store = m_window.backingStore();
    if (!window || !m_store || !m_window.isVisible() || m_store->size().isEmpty()) {
        return nullptr;
    }
    // An empty region: the store is made ready for drawing (on some displays nothing is shown without), but nothing of
    // it is cleared.
    m_began = m_painting == 0;
    if (m_began) {
        m_store->beginPaint(QRegion());
    }
    QImage* image = imageOf(*m_store);
    if (image && image->depth() == 32) {
        m_alias = plainAlias(*image, QImage::Format_RGB32);
        return &m_alias;
    }
    readCopy(image, wanted);
    return &m_copy;
}

namespace {

/// A rectangle of a window in pixels.
QRectF scaledRect(const QRect& units, double ratio) {
    return {QPointF(units.topLeft()) * ratio, QSizeF(units.size()) * ratio};
}

QSize pixelSize(QSize units, double ratio) {
    return {static_cast<int>(std::ceil(units.width() * ratio)), static_cast<int>(std::ceil(units.height() * ratio))};
}

} // namespace

void WindowSurface::readCopy(const QImage* image, const QRect& wanted) {
    if (const QSize size = pixelSize(m_window.size(), ratio()); m_copy.size() != size) {
        m_copy = QImage(size, QImage::Format_RGB32);
        m_copy.fill(m_window.palette().color(QPalette::Window));
    }
    if (!image) {
        return; // pixels that cannot be read: what was drawn last has to do
    }
    QPainter painter(&m_copy);
    painter.setCompositionMode(QPainter::CompositionMode_Source);
    const QRectF part = scaledRect(wanted, ratio());
    painter.drawImage(part, *image, part);
}

void WindowSurface::writeCopy(const QRect& touched) {
    QPainter painter(m_store->paintDevice());
    painter.drawImage(QRectF(touched), m_copy, scaledRect(touched, ratio()));
}

void WindowSurface::close(const QRect& touched, ShownBy shownBy) {
    if (!touched.isEmpty()) {
        if (m_alias.isNull()) {
            writeCopy(touched);
        }
        if (shownBy == ShownBy::Flush) {
            showLater(touched);
        }
    }
    m_alias = QImage();
    if (m_began) {
        m_store->endPaint();
    }
    m_began = false;
}

/// A context that is kept open for longer shows its drawing when the program looks for the next message.
void WindowSurface::showLater(const QRect& part) {
    m_unshown |= part;
    if (std::exchange(m_flushIsPosted, true)) {
        return;
    }
    const auto posted = [this] {
        m_flushIsPosted = false;
        flush();
    };
    QMetaObject::invokeMethod(this, posted, Qt::QueuedConnection);
}

void WindowSurface::endPaint() {
    if (--m_painting == 0 && !m_unshown.isEmpty()) {
        showLater(QRect());
    }
}

namespace {

/// Tells the store what was drawn. Displays that share no memory with the program are sent only what was announced;
/// but the toolkit clears what is announced where pixels have an alpha.
void announce(QBackingStore& store, const QRegion& part) {
    QImage* image = imageOf(store);
    if (!image) {
        return;
    }
    const QRect place = scaledRect(part.boundingRect(), image->devicePixelRatio()).toAlignedRect() & image->rect();
    const QImage drawn = plainAlias(*image, image->format()).copy(place);
    store.beginPaint(part);
    if (drawn.hasAlphaChannel() && imageOf(store)) {
        QImage cleared = plainAlias(*imageOf(store), drawn.format());
        QPainter painter(&cleared);
        painter.setCompositionMode(QPainter::CompositionMode_Source);
        painter.drawImage(place.topLeft(), drawn);
    }
    store.endPaint();
}

/// Shows a part of a store in a window and in the native windows inside of it, which cover their part of it.
void flushInto(QBackingStore& store, QWindow& window, QRegion part, QPoint offset) {
    const QObjectList& inner = window.children();
    for (auto object = inner.rbegin(); object != inner.rend(); ++object) {
        auto* child = qobject_cast<QWindow*>(*object);
        if (child && child->isVisible() && child->surfaceType() == QSurface::RasterSurface) {
            const QRect place = child->geometry();
            flushInto(store, *child, (part & place).translated(-place.topLeft()), offset + place.topLeft());
            part -= place;
        }
    }
    if (!part.isEmpty()) {
        store.flush(part, &window, offset);
    }
}

} // namespace

void WindowSurface::flush() {
    if (m_painting > 0 || m_unshown.isEmpty()) {
        return;
    }
    const QRegion part = withBrokenPixels(m_window, std::exchange(m_unshown, QRect())) & m_window.rect();
    QBackingStore* store = m_window.backingStore();
    QWindow* window = m_window.windowHandle();
    if (!store || !window || !m_window.isVisible() || part.isEmpty()) {
        return;
    }
    announce(*store, part);
    flushInto(*store, *window, part, QPoint());
}

namespace {

/// Group boxes stand around controls of the same dialog; what is inside of them is the dialog's.
bool keepsItsPixels(const QWidget& child, WindowPart part) {
    if (child.isHidden() || child.isWindow() || qobject_cast<const QGroupBox*>(&child)) {
        return false;
    }
    return part == WindowPart::Client || !qobject_cast<const QMenuBar*>(&child);
}

/// What a widget covers of its parent: child frames have round corners.
QRegion coveredBy(const QWidget& child) {
    const QRegion mask = child.mask();
    return mask.isEmpty() ? QRegion(child.geometry()) : mask.translated(child.pos());
}

void subtractChildren(QRegion& region, const QWidget& widget, WindowPart part) {
    for (const QObject* object : widget.children()) {
        const auto* child = qobject_cast<const QWidget*>(object);
        if (child && keepsItsPixels(*child, part)) {
            region -= coveredBy(*child);
        } else if (const auto* bar = qobject_cast<const QMenuBar*>(child); bar && !bar->isHidden()) {
            // The buttons of a maximised child frame stand in the bar.
            QRegion within = bar->rect();
            subtractChildren(within, *bar, part);
            region -= QRegion(bar->geometry()) - within.translated(bar->pos());
        }
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
                region -= coveredBy(*sibling).translated(widget.mapFrom(level->parentWidget(), QPoint()));
            }
        }
    }
}

} // namespace

QRegion drawableRegion(const QWidget& widget, WindowPart part) {
    QRegion region = widget.visibleRegion();
    if (part == WindowPart::Whole) {
        // The toolkit's visible region leaves opaque children out, the menu bar too.
        region = widget.mask().isEmpty() ? QRegion(widget.rect()) : widget.mask();
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
    : m_widget(&widget), m_part(part), m_area(std::move(area)) {}

bool WindowTarget::open(Canvas& canvas, QRegion& visible) {
    if (!m_widget || !m_widget->isVisible()) {
        return false;
    }
    const QRect area = m_area();
    if (!m_drawable || !layoutIsFixed) {
        m_drawable = drawableRegion(*m_widget, m_part) & area;
        if (limit) {
            *m_drawable &= *limit;
        }
    }
    const QRegion& clip = *m_drawable;
    const QPoint widgetOrigin = m_widget->mapTo(m_widget->window(), QPoint());
    m_origin = widgetOrigin + area.topLeft();
    WindowSurface& surface = WindowSurface::of(*m_widget);
    canvas.image = surface.open(clip.boundingRect().translated(widgetOrigin));
    canvas.origin = m_origin;
    canvas.ratio = surface.ratio();
    visible = clip.translated(-area.topLeft());
    return canvas.image;
}

void WindowTarget::close(const QRect& touched) {
    m_used = true;
    if (m_widget) {
        WindowSurface::of(*m_widget).close(touched.isEmpty() ? QRect() : touched.translated(m_origin), shownBy);
    }
}

QSize WindowTarget::size() const {
    return m_widget ? m_area().size() : QSize();
}

double WindowTarget::ratio() const {
    return m_widget ? WindowSurface::of(*m_widget).ratio() : 1;
}

void WindowTarget::release() {
    if (m_widget && m_used) {
        WindowSurface::of(*m_widget).flush();
    }
}

// A paint event

PaintTarget::PaintTarget(QWidget& widget, const QRegion& update, std::function<QRect()> area)
    : m_widget(&widget), m_update(update), m_area(area), m_window(widget, WindowPart::Client, std::move(area)) {
    m_window.limit = update;
    if (!widget.testAttribute(Qt::WA_WState_InPaintEvent)) {
        return; // nothing is being painted: `update` limits what can be drawn
    }
    takePicture();
    if (!m_picture.isNull()) {
        return;
    }
    m_surface = &WindowSurface::of(widget);
    m_surface->beginPaint();
    m_window.shownBy = WindowSurface::ShownBy::Toolkit;
    m_window.layoutIsFixed = true;
}

PaintTarget::~PaintTarget() {
    if (m_surface) {
        m_surface->endPaint();
    }
}

/// Finds out whether the widget is being painted on anything but its window, and takes what is there so far.
void PaintTarget::takePicture() {
    QPainter painter(m_widget);
    QPaintDevice* device = painter.paintEngine() ? painter.paintEngine()->paintDevice() : nullptr;
    QBackingStore* store = m_widget->backingStore();
    if (!device || (store && device == store->paintDevice())) {
        return;
    }
    m_pictureRatio = device->devicePixelRatio();
    m_picture = QImage(pixelSize(m_widget->size(), m_pictureRatio), QImage::Format_RGB32);
    m_picture.fill(m_widget->palette().color(m_widget->backgroundRole()));
    const QPoint place = painter.deviceTransform().map(QPoint());
    QPainter copier(&m_picture);
    if (const auto* pixmap = dynamic_cast<QPixmap*>(device)) {
        copier.drawPixmap(m_picture.rect(), *pixmap, m_picture.rect().translated(place));
    } else if (const auto* image = dynamic_cast<QImage*>(device)) {
        copier.drawImage(m_picture.rect(), *image, m_picture.rect().translated(place));
    }
}

bool PaintTarget::open(Canvas& canvas, QRegion& visible) {
    if (m_picture.isNull()) {
        return m_window.open(canvas, visible);
    }
    const QRect area = m_area();
    canvas.image = &m_picture;
    canvas.origin = area.topLeft();
    canvas.ratio = m_pictureRatio;
    visible = (m_update & area).translated(-area.topLeft());
    return true;
}

void PaintTarget::close(const QRect& touched) {
    if (m_picture.isNull()) {
        m_window.close(touched);
    } else if (!touched.isEmpty()) {
        m_drawn |= touched.translated(m_area().topLeft());
    }
}

QSize PaintTarget::size() const {
    return m_window.size();
}

double PaintTarget::ratio() const {
    return m_picture.isNull() ? m_window.ratio() : m_pictureRatio;
}

void PaintTarget::release() {
    if (!m_picture.isNull() && m_widget && !m_drawn.isEmpty()) {
        QPainter painter(m_widget);
        painter.setClipRegion(m_update);
        painter.drawImage(QRectF(m_drawn), m_picture, scaledRect(m_drawn, m_pictureRatio));
    }
    m_window.release();
}

} // namespace tvx::afx
