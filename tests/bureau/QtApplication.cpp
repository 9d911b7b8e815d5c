// The one QApplication of the desktop host's tests, on the offscreen platform unless another is asked for:
// the windows are built, driven and drawn without a display.
#include <QApplication>
#include <gtest/gtest.h>

namespace {

class QtApplication : public testing::Environment {
public:
    void SetUp() override {
        if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
        static int argc = 1;
        static char name[] = "test_bureau";
        static char* argv[] = {name, nullptr};
        m_application = std::make_unique<QApplication>(argc, argv);
    }
    void TearDown() override { m_application.reset(); }

private:
    std::unique_ptr<QApplication> m_application;
};

[[maybe_unused]] testing::Environment* const g_application =
    testing::AddGlobalTestEnvironment(new QtApplication);

} // namespace
