#include "desktop/help/HelpWindow.h"

#include "core/Prompts.h"
#include "core/settings/AppState.h"
#include "desktop/help/HelpIcons.h"
#include "desktop/help/PrintDocument.h"
#include "desktop/shell/PlatformDialogs.h"

#include <QEvent>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QMouseEvent>
#include <QPrinter>
#include <QTextBlock>
#include <QTextCursor>
#include <QTextDocument>
#include <QTextEdit>
#include <QVBoxLayout>

namespace {

// Topics keep CR LF line ends as read; the text widgets want plain line feeds.
QString displayText(const QString& topic) {
    QString text = topic;
    text.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    return text;
}

QFont fixedFont(const QString& family, qreal points) {
    QFont font(family);
    font.setStyleHint(QFont::TypeWriter);
    font.setFixedPitch(true);
    font.setPointSizeF(points);
    return font;
}

} // namespace

HelpWindow::HelpWindow(HelpKind kind, AppState& state, Prompts& prompts, PlatformDialogs& dialogs,
                       const QString& folder, QWidget* parent)
    : QDialog(parent), kind_(kind), state_(state), prompts_(prompts), dialogs_(dialogs),
      folder_(folder) {
    const bool general = kind == HelpKind::General;
    setObjectName(general ? QStringLiteral("frmHelp") : QStringLiteral("frmK5Help"));
    setWindowTitle(general ? QStringLiteral("  Help  (General)")
                           : QStringLiteral("  Help  (Other)"));
    setModal(true);
    buildControls();
    LoadHelpFile();
    selectedTopic_ = 0;
    HelpSelect(0);
    text_->setFocus();
}

void HelpWindow::buildControls() {
    text_ = new QTextEdit(this);
    text_->setObjectName(QStringLiteral("RichTextBox1"));
    text_->setReadOnly(true);
    text_->setAcceptRichText(false);
    text_->setFont(fixedFont(QStringLiteral("Courier"), 9.75));
    text_->setLineWrapMode(QTextEdit::WidgetWidth);
    const QFontMetrics metrics(text_->font());
    text_->setMinimumSize(metrics.horizontalAdvance(QLatin1Char('M')) * 76,
                          metrics.lineSpacing() * 32);
    text_->installEventFilter(this);
    installEventFilter(this);

    auto* layout = new QHBoxLayout(this);
    layout->addWidget(buildTopicColumn());
    layout->addWidget(text_, 1);
}

QWidget* HelpWindow::buildTopicColumn() {
    auto* column = new QWidget(this);
    auto* rows = new QVBoxLayout(column);
    rows->setContentsMargins(0, 0, 8, 0);
    const QStringList captions = HelpFile::topicCaptions(kind_);
    const QPixmap arrowPixmap = HelpIcons::arrow();
    for (int i = 0; i < captions.size(); ++i) {
        if (kind_ == HelpKind::General && i == 5) {
            // Heading over the two GLP topics.
            auto* glp = new QLabel(QStringLiteral("Good  Laboratory  Practices"), column);
            glp->setObjectName(QStringLiteral("Label20"));
            QFont bold = glp->font();
            bold.setBold(true);
            glp->setFont(bold);
            rows->addSpacing(6);
            rows->addWidget(glp);
        }
        if (i == HelpFile::printIndex(kind_))
            rows->addSpacing(12);
        auto* arrow = new QLabel(column);
        arrow->setObjectName(QStringLiteral("imgArrow_%1").arg(i));
        arrow->setPixmap(arrowPixmap);
        arrow->setFixedSize(arrowPixmap.size());
        // Keeps its room when hidden, so the labels do not jump about.
        QSizePolicy keep = arrow->sizePolicy();
        keep.setRetainSizeWhenHidden(true);
        arrow->setSizePolicy(keep);

        auto* label = new QLabel(captions.at(i), column);
        label->setObjectName(QStringLiteral("lblHelpTopic_%1").arg(i));
        label->setTextFormat(Qt::PlainText);
        label->setCursor(Qt::PointingHandCursor);
        label->installEventFilter(this);

        auto* row = new QHBoxLayout;
        row->addWidget(arrow);
        row->addWidget(label, 1);
        rows->addLayout(row);
        arrows_.append(arrow);
        labels_.append(label);
    }
    rows->addStretch(1);
    print_ = new QLabel(column);
    print_->setObjectName(QStringLiteral("imgPrint"));
    print_->setPixmap(HelpIcons::printer());
    print_->setToolTip(QStringLiteral("Print help file"));
    print_->setCursor(Qt::PointingHandCursor);
    print_->installEventFilter(this);
    rows->addWidget(print_, 0, Qt::AlignHCenter);
    return column;
}

void HelpWindow::LoadHelpFile() {
    state_.helpTopics = HelpFile::load(folder_, kind_);
}

void HelpWindow::HelpSelect(int index) {
    if (index < 0 || index >= labels_.size())
        return;
    for (int i = 0; i < arrows_.size(); ++i)
        arrows_.at(i)->setVisible(i == index);
    shownTopic_ = index;

    // No painting while the text is filled and styled (hiding the widget would take its focus).
    text_->setUpdatesEnabled(false);
    text_->setPlainText(displayText(state_.helpTopics.value(index)));
    QTextCursor all(text_->document());
    all.select(QTextCursor::Document);
    QTextCharFormat plain;
    plain.setFontWeight(QFont::Normal);
    plain.setFontUnderline(false);
    all.mergeCharFormat(plain);
    // The title line, its line break included, is the heading.
    QTextCursor title(text_->document()->begin());
    title.movePosition(QTextCursor::EndOfBlock, QTextCursor::KeepAnchor);
    title.movePosition(QTextCursor::NextCharacter, QTextCursor::KeepAnchor);
    QTextCharFormat heading;
    heading.setFontWeight(QFont::Bold);
    heading.setFontUnderline(true);
    title.mergeCharFormat(heading);
    text_->moveCursor(QTextCursor::Start);
    text_->setUpdatesEnabled(true);
}

void HelpWindow::PrintHelpFile() {
    QPrinter own;
    QPrinter& printer = printer_ ? *printer_ : own;
    if (!dialogs_.askPrinter(this, printer))
        return;
    // A hidden document of its own: the window keeps showing its topic.
    QTextDocument document;
    document.setDefaultFont(fixedFont(QStringLiteral("Courier New"), 9.75));
    const QString text = HelpFile::composePrintText(state_.helpTopics, HelpFile::printIndex(kind_));
    document.setPlainText(displayText(text));
    if (!printDocument(document, printer)) {
        const QString target =
            printer.outputFileName().isEmpty() ? printer.printerName() : printer.outputFileName();
        prompts_.show(
            target.isEmpty()
                ? QStringLiteral("The help file could not be printed: no printer is set up.")
                : QStringLiteral("The help file could not be printed on %1.").arg(target),
            Prompts::Icon::Information, Prompts::Buttons::Ok);
    }
}

void HelpWindow::moveSelection(int step) {
    const int count = HelpFile::topicCount(kind_);
    selectedTopic_ = (selectedTopic_ + step + count) % count;
    HelpSelect(selectedTopic_);
}

void HelpWindow::runLabel(int index) {
    if (index == HelpFile::printIndex(kind_))
        PrintHelpFile();
    else if (index == HelpFile::exitIndex(kind_))
        close();
    else
        HelpSelect(index);
}

bool HelpWindow::handleKey(int key) {
    switch (key) {
    case Qt::Key_Up:
    case Qt::Key_Backtab:
        moveSelection(-1);
        return true;
    case Qt::Key_Down:
    case Qt::Key_Tab:
        moveSelection(1);
        return true;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        // Only the print and exit labels act on Enter; it is swallowed on a topic.
        if (selectedTopic_ == HelpFile::printIndex(kind_))
            PrintHelpFile();
        else if (selectedTopic_ == HelpFile::exitIndex(kind_))
            close();
        return true;
    default:
        return false;
    }
}

bool HelpWindow::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::KeyPress && (watched == this || watched == text_)) {
        const auto* key = static_cast<QKeyEvent*>(event);
        const auto mods = key->modifiers() & ~(Qt::KeypadModifier | Qt::ShiftModifier);
        if (mods == Qt::NoModifier && handleKey(key->key()))
            return true;
    } else if (event->type() == QEvent::MouseButtonPress) {
        const auto* mouse = static_cast<QMouseEvent*>(event);
        if (mouse->button() != Qt::LeftButton)
            return false;
        if (watched == print_) {
            PrintHelpFile();
            return true;
        }
        const int index = labels_.indexOf(qobject_cast<QLabel*>(watched));
        if (index >= 0) {
            runLabel(index);
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

#include "moc_HelpWindow.cpp"
