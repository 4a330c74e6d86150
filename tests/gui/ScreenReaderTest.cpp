// What assistive tools see of the built program, asked as they do: over the accessibility bus.

#include "tests/gui/RealProgram.h"
#include "tests/support/ToolRun.h"

#include <QDBusArgument>
#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusVariant>
#include <gtest/gtest.h>

#include <optional>
#include <thread>

namespace {

/// One object of a program, as the bus names it.
struct Accessible {
    QString program;
    QString path;
};

const QDBusArgument& operator>>(const QDBusArgument& argument, Accessible& object)
{
    QDBusObjectPath path;
    argument.beginStructure();
    argument >> object.program >> path;
    argument.endStructure();
    object.path = path.path();
    return argument;
}

std::vector<Accessible> objectsIn(const QDBusArgument& argument)
{
    std::vector<Accessible> objects;
    for (argument.beginArray(); !argument.atEnd();)
        argument >> objects.emplace_back();
    argument.endArray();
    return objects;
}

class ScreenReaderTest : public testing::Test {
protected:
    // The numbers are those of the bus.
    enum State { kFocusable = 11, kShowing = 25 };
    static constexpr unsigned kLabelledBy = 2;

    ScreenReaderTest()
    {
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        for (const char* folder : {"HOME", "XDG_RUNTIME_DIR"}) // where the bus has its socket
            environment.insert(folder, QString::fromStdString(home_.path.string()));
        session_.setProcessEnvironment(environment);
        session_.start("dbus-daemon", {"--session", "--nofork", "--nopidfile", "--print-address"});
        if (!session_.waitForReadyRead())
            throw std::runtime_error("dbus-daemon does not start");
        const QString session = QString::fromUtf8(session_.readLine()).trimmed();
        const QString address = send(QDBusConnection::connectToBus(session, "session"),
                                     {"org.a11y.Bus", "/org/a11y/bus"}, "org.a11y.Bus", "GetAddress")
                                    .toString();
        bus_.emplace(QDBusConnection::connectToBus(address, "accessibility"));
        makeSample();
        program_.emplace(PELORIN_PROGRAM, home_.path.string(),
                         RealProgram::Variables{{"DBUS_SESSION_BUS_ADDRESS", session.toStdString()},
                                                {"QT_LINUX_ACCESSIBILITY_ALWAYS_ON", "1"}});
    }
    ~ScreenReaderTest() override
    {
        program_.reset();
        for (const char* name : {"session", "accessibility"})
            QDBusConnection::disconnectFromBus(name);
        session_.terminate(); // which ends those of the accessibility bus
        session_.waitForFinished();
    }

    void makeSample() const
    {
        const ToolRun run(PELORIN_SAMPLE, "'" + (home_.path / "Documents/Pelorin").string() + "'",
                          TemporaryFolder("pelorin-sampler"));
        ASSERT_EQ(run.status, 0) << run.err;
    }
    static QVariant send(const QDBusConnection& bus, const Accessible& to, const char* interface, const char* method,
                         const QVariantList& arguments = {})
    {
        QDBusMessage call = QDBusMessage::createMethodCall(to.program, to.path, interface, method);
        call.setArguments(arguments);
        const QDBusMessage reply = bus.call(call);
        if (reply.type() != QDBusMessage::ReplyMessage || reply.arguments().empty())
            throw std::runtime_error(to.program.toStdString() + to.path.toStdString() + ' ' + method + ": " +
                                     reply.errorMessage().toStdString());
        return reply.arguments().at(0);
    }
    QVariant ask(const Accessible& object, const char* method) const
    {
        return send(*bus_, object, "org.a11y.atspi.Accessible", method);
    }
    std::string nameOf(const Accessible& object) const
    {
        return send(*bus_, object, "org.freedesktop.DBus.Properties", "Get", {"org.a11y.atspi.Accessible", "Name"})
            .value<QDBusVariant>()
            .variant()
            .toString()
            .toStdString();
    }
    std::string roleOf(const Accessible& object) const { return ask(object, "GetRoleName").toString().toStdString(); }
    std::vector<Accessible> childrenOf(const Accessible& object) const
    {
        return objectsIn(ask(object, "GetChildren").value<QDBusArgument>());
    }
    bool is(const Accessible& object, State state) const
    {
        const auto words = qdbus_cast<QList<unsigned>>(ask(object, "GetState"));
        return (words.at(0) >> state & 1U) != 0;
    }
    bool hasLabel(const Accessible& object) const
    {
        const auto relations = ask(object, "GetRelationSet").value<QDBusArgument>();
        bool isLabelled = false;
        for (relations.beginArray(); !relations.atEnd();) {
            unsigned kind;
            relations.beginStructure();
            relations >> kind;
            for (const Accessible& label : objectsIn(relations))
                isLabelled = isLabelled || (kind == kLabelledBy && !nameOf(label).empty());
            relations.endStructure();
        }
        relations.endArray();
        return isLabelled;
    }
    Accessible programOnBus() const
    {
        for (int i = 0; i < 600; ++i) {
            for (const Accessible& child : childrenOf({"org.a11y.atspi.Registry", "/org/a11y/atspi/accessible/root"}))
                return child;
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
        }
        throw std::runtime_error("the program does not come to the bus");
    }
    /// Looks at what shows within `object`, itself included. @return how many controls there are.
    int check(const Accessible& object, const std::string& around)
    {
        const std::string role = roleOf(object), name = nameOf(object);
        const std::string where = around + " > " + role + " '" + name + "'";
        int controls = 0;
        if (is(object, kFocusable)) {
            ++controls;
            EXPECT_NE(name, "") << where;
            EXPECT_TRUE(role != "unknown" && role != "filler" && role != "panel" && role != "invalid") << where;
        }
        if (is(object, kFocusable) && (role == "text" || role == "combo box")) {
            EXPECT_TRUE(hasLabel(object)) << where;
        }
        int rows = 0;
        for (const Accessible& child : childrenOf(object)) {
            if (is(child, kShowing) && (role != "list" || ++rows <= kRowsLookedAt))
                controls += check(child, where);
        }
        return controls;
    }

    static constexpr int kRowsLookedAt = 2;
    const TemporaryFolder home_{"pelorin-reader"};
    QProcess session_;
    std::optional<QDBusConnection> bus_;
    std::optional<RealProgram> program_;
};

TEST_F(ScreenReaderTest, EveryControlHasANameAndARoleAndFieldsTheirLabels)
{
    const Accessible program = programOnBus();
    EXPECT_EQ(roleOf(childrenOf(program).at(0)), "frame");
    program_->key("ctrl+o");
    program_->awaitWindow("Load");
    program_->type("Sample");
    program_->key("Return");
    program_->awaitNoWindow("Load");
    const int least[] = {25, 15, 20, 8, 11};
    for (int page = 0; page < 5; ++page) {
        program_->key("alt+" + std::to_string(page + 1));
        EXPECT_GE(check(program, "page " + std::to_string(page + 1)), least[page]) << page;
    }
    EXPECT_EQ(program_->quit(), 0);
}

} // namespace
