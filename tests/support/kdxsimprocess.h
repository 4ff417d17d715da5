#pragma once

#include <QProcess>
#include <QRegularExpression>

#include <csignal>
#include <cstdint>
#include <stdexcept>
#include <string>

namespace kdx::test {

/// The program kdx-sim as a process of its own: started, killed, made to hang and started again at the same port.
class KdxSimProcess {
public:
    KdxSimProcess() { m_process.setProcessChannelMode(QProcess::SeparateChannels); }
    ~KdxSimProcess() { kill(); }
    KdxSimProcess(const KdxSimProcess&) = delete;
    KdxSimProcess& operator=(const KdxSimProcess&) = delete;

    /// Returns when it serves. From the second start on it listens at the port that it had before.
    void start(const QStringList& options = {}) {
        m_process.start(QStringLiteral(KDX_SIM_PROGRAM),
                        options + QStringList{QStringLiteral("--port"), QString::number(m_port)});
        while (!m_process.canReadLine()) {
            if (!m_process.waitForReadyRead()) {
                throw std::runtime_error("kdx-sim does not start: " + m_process.readAllStandardError().toStdString());
            }
        }
        const QString ready = QString::fromLatin1(m_process.readLine());
        const auto match = QRegularExpression(QStringLiteral("^ready: \\S+ port (\\d+)")).match(ready);
        if (!match.hasMatch()) throw std::runtime_error("kdx-sim is not ready: " + ready.toStdString());
        m_port = match.captured(1).toUShort();
    }
    [[nodiscard]] std::uint16_t port() const { return m_port; }

    /// Gone at once, as when the instrument loses its power.
    void kill() {
        if (m_process.state() == QProcess::NotRunning) return;
        m_process.kill();
        m_process.waitForFinished();
    }
    /// Only the signal: for another thread than the one that started the process.
    void killFromOutside() const { ::kill(id(), SIGKILL); }
    /// It keeps its connections, takes new ones, and answers nothing.
    void hang() const { ::kill(id(), SIGSTOP); }
    void goOn() const { ::kill(id(), SIGCONT); }
    /// Ends it in peace; gives what it has printed since it was ready.
    std::string end() {
        m_process.terminate();
        m_process.waitForFinished();
        return m_process.readAllStandardOutput().toStdString();
    }

private:
    [[nodiscard]] pid_t id() const { return static_cast<pid_t>(m_process.processId()); }

    QProcess m_process;
    std::uint16_t m_port = 0;
};

}  // namespace kdx::test
