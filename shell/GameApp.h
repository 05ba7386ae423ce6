#pragma once

#include <QApplication>

#include <memory>

class CMainFrame;

// The application: creates the frame and keeps it for the life of the process.
class CGameApp : public QApplication {
    Q_OBJECT

public:
    CGameApp(int& argc, char** argv);
    ~CGameApp() override;

    bool InitInstance();
    CMainFrame* MainFrame() const { return mainFrame.get(); }

private:
    std::unique_ptr<CMainFrame> mainFrame;
};
