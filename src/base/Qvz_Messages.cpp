#include "Qvz_Messages.h"

#include "Qvz_WizMain.h"
#include "Wg_Wizard.h"

#include <QApplication>
#include <QDialog>
#include <QDialogButtonBox>
#include <QFile>
#include <QMessageBox>
#include <QRegularExpression>
#include <QTextBrowser>
#include <QVBoxLayout>

#include <cstdio>

namespace {

QWidget* DialogOf(const Qvz_WizMain* main) {
    return main ? main->GetWizard() : nullptr;
}

// Message boxes and windows need a GUI application; a console host has none.
bool HaveGui() {
    return qobject_cast<QApplication*>(QCoreApplication::instance()) != nullptr;
}

} // namespace

void Qvz_StderrSink::Show(const Qvz_Message& message) {
    std::fprintf(stderr, "%s%s\n", message.flag1 ? "error: " : "note: ", message.text.c_str());
    std::fflush(stderr);
}

void Qvz_MessageBoxSink::Show(const Qvz_Message& message) {
    if (!HaveGui()) {
        Qvz_StderrSink().Show(message);
        return;
    }
    QWidget* parent = DialogOf(m_pMain);
    const QString title =
        parent ? parent->windowTitle() : (m_pMain ? m_pMain->GetName().ToQString() : QString());
    QMessageBox box(message.flag1 ? QMessageBox::Critical : QMessageBox::Information, title,
                    message.text.ToQString(), QMessageBox::Ok, parent);
    box.setObjectName("wizardMessage");
    box.exec();
}

Qvz_HelpWindow::~Qvz_HelpWindow() {
    delete m_window.data();
}

QString Qvz_HelpWindow::PageOf(const Port::StringBase& key) {
    // Keys are plain names; anything else must not reach into other resources.
    static const QRegularExpression plain("^[a-z0-9_]+$");
    const QString k = key.ToQString();
    if (!plain.match(k).hasMatch())
        return QString();
    const QString path = ":/help/" + k + ".html";
    return QFile::exists(path) ? path : QString();
}

void Qvz_HelpWindow::Open(const Port::StringBase& key) {
    if (!HaveGui())
        return;
    QWidget* parent = DialogOf(m_pMain);
    if (m_window && m_window->parentWidget() != parent)
        delete m_window.data();
    if (!m_window) {
        m_window = new QDialog(parent);
        m_window->setObjectName("helpWindow");
        m_window->setAttribute(Qt::WA_DeleteOnClose);
        m_window->resize(640, 560);
        auto* layout = new QVBoxLayout(m_window);
        m_browser = new QTextBrowser(m_window);
        m_browser->setObjectName("helpBrowser");
        m_browser->setOpenExternalLinks(true);
        layout->addWidget(m_browser);
        auto* buttons = new QDialogButtonBox(QDialogButtonBox::Close, m_window);
        QObject::connect(buttons, &QDialogButtonBox::rejected, m_window.data(), &QDialog::close);
        layout->addWidget(buttons);
    }
    const QString page = PageOf(key);
    if (page.isEmpty()) {
        m_browser->setHtml(QString("<p>No help is available for \"%1\".</p>")
                               .arg(key.ToQString().toHtmlEscaped()));
        m_window->setWindowTitle("Help");
    } else {
        m_browser->setSource(QUrl("qrc" + page));
        const QString title = m_browser->documentTitle();
        m_window->setWindowTitle(title.isEmpty() ? QString("Help") : "Help: " + title);
    }
    m_window->show();
    m_window->raise();
    m_window->activateWindow();
}

QDialog* Qvz_HelpWindow::Window() const {
    return m_window;
}
