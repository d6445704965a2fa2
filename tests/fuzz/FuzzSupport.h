// Shared by the fuzz targets: the application they need once, an automation listener that
// answers every assertion (a fuzzer must never wait on a box), and a byte reader.
#pragma once

#include <Velmar/HostCore.h>

#include <QApplication>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace VelmarFuzz {

// Every assertion is answered "Ignore": hostile input is supposed to raise them.
class IgnoreAll : public Velmar::AutomationListener {
public:
    QString AnswerDialog(const QString&, const QString&, const QString&) override
    {
        return QStringLiteral("Ignore");
    }
};

// Made once per process, offscreen, before the first input.
inline void ensureApplication()
{
    if (QCoreApplication::instance())
        return;
    qputenv("QT_QPA_PLATFORM", "offscreen");
    static int argc = 1;
    static char name[] = "velmar-fuzz";
    static char* argv[] = {name, nullptr};
    static QApplication* app = new QApplication(argc, argv);
    (void)app;
    Velmar::AutomationListenerManager::SetListener(new IgnoreAll);
    // The fuzzer checks invariants, not log lines: keep the output quiet.
    qInstallMessageHandler([](QtMsgType type, const QMessageLogContext&, const QString& message) {
        if (type == QtFatalMsg) {
            fprintf(stderr, "%s\n", qPrintable(message));
            abort();
        }
    });
}

// Reads the input a piece at a time; runs dry into zeros.
class Bytes {
public:
    Bytes(const uint8_t* data, size_t size) : m_data(data), m_size(size) {}
    bool empty() const { return m_pos >= m_size; }
    uint8_t u8() { return m_pos < m_size ? m_data[m_pos++] : 0; }
    uint16_t u16() { return uint16_t(u8() | (u8() << 8)); }
    int16_t s16() { return int16_t(u16()); }
    uint32_t u32() { return uint32_t(u16()) | (uint32_t(u16()) << 16); }
    // Up to `max` bytes of what is left.
    size_t take(void* out, size_t max)
    {
        const size_t n = std::min(max, m_size - std::min(m_pos, m_size));
        std::memcpy(out, m_data + m_pos, n);
        m_pos += n;
        return n;
    }

private:
    const uint8_t* m_data;
    size_t m_size;
    size_t m_pos = 0;
};

// A broken invariant ends the run loudly, with what was found.
#define FUZZ_CHECK(cond)                                                                           \
    do {                                                                                           \
        if (!(cond)) {                                                                             \
            fprintf(stderr, "fuzz invariant broken: %s (%s:%d)\n", #cond, __FILE__, __LINE__);     \
            abort();                                                                               \
        }                                                                                          \
    } while (0)

} // namespace VelmarFuzz
