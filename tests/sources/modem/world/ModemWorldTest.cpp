#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <unistd.h>

// The real program on modems that scripts play, through the real ModemManager where it can.

namespace pallax {
namespace {

using doubles::CommandRun;
using doubles::isInstalled;
using doubles::runCommand;

const std::string kWorlds = PALLAX_SOURCE_DIR "/tests/sources/modem/world/";

class ModemWorld : public testing::Test {
protected:
    ~ModemWorld() override { std::filesystem::remove(_printedPolicy); }

    void SetUp() override {
        for (const char* program : {"dbus-daemon", "gdbus", "mmcli", "python3", "setpriv"}) {
            if (!isInstalled(program)) {
                GTEST_SKIP() << program << " is not installed";
            }
        }
    }

    /// Runs steps, which may not contain ', in a world, and gives what they print; if the world
    /// fails, what it says.
    static CommandRun in(const std::string& world, const std::string& steps) {
        return runCommand("told=$(mktemp); STEPS_OUT=$told PALLAX=" PALLAX_PROGRAM " " + kWorlds +
                          world + " -- bash -c '. " + kWorlds + "steps.bash\n" + steps +
                          "' >$told.world 2>&1 || cat $told.world; cat $told; rm $told*");
    }

    /// The same, all of it as an ordinary user, also if the test's user is root.
    static CommandRun asOrdinaryUserIn(const std::string& world, const std::string& steps) {
        const bool isRoot = ::geteuid() == 0;
        const std::string asNobody = "setpriv --reuid=65534 --regid=65534 --clear-groups ";
        return runCommand("told=$(mktemp); chmod 666 $told; STEPS_OUT=$told "
                          "PALLAX=" PALLAX_PROGRAM " " +
                          (isRoot ? asNobody : "") + kWorlds + world + " -- bash -c '. " + kWorlds +
                          "steps.bash\n" + steps +
                          "' >$told.world 2>&1 || cat $told.world; cat $told; rm $told*");
    }

    /// Arguments for ModemManager's policy of the system bus.
    static std::string policy() {
        const auto installed =
            runCommand("dpkg -L modemmanager | "
                       "grep 'dbus-1/system.d/org.freedesktop.ModemManager1.conf'");
        return " --policy " + installed.out.substr(0, installed.out.find('\n'));
    }
    /// Arguments for the policy that Pallax prints. The bus may read it before ModemManager's.
    std::string printedPolicy() const {
        EXPECT_EQ(runCommand(PALLAX_PROGRAM " modem --policy >" + _printedPolicy).status, 0);
        return " --policy " + _printedPolicy;
    }

private:
    std::string _printedPolicy =
        testing::TempDir() + std::to_string(::getpid()) + "-pallax-cells.conf";
};

TEST_F(ModemWorld, AnAtModemAppearsMovesLosesServiceAndComesBack) {
    const auto run = in("at-world", R"steps(
        begin_pallax modem --print
        shows "Modem/State: registered"
        shows "Registration/State: home"
        shows "Registration/Operator: SampleNet"
        shows "Serving Cell/Source: location only"
        shows "Serving Cell/Cell ID: 13828438"
        shows "Signal/LTE RSRP: -95.0 dBm"
        echo "level -110" >"$WORLD/a.control"
        echo "cell 84CE 00D30201" >"$WORLD/a.control"
        shows "Serving Cell/RSRP: -110.0 dBm"
        shows "Serving Cell/Cell ID: 13828609"
        shows "Serving Cell/TAC: 33998"
        echo "registration 2" >"$WORLD/a.control"
        shows "Registration/State: searching"
        echo "registration 5" >"$WORLD/a.control"
        shows "Registration/State: roaming"
        echo unplug >"$WORLD/a.control"
        shows "Modem/State: unplugged"
        shows "Modem/Model: AT-9"
        echo plug >"$WORLD/a.control"
        shows "Modem/State: disabled"
        shows "Modem/Model: AT-9"
        end_pallax)steps");
    EXPECT_EQ(run.out, "Modem/State: registered\n"
                       "Registration/State: home\n"
                       "Registration/Operator: SampleNet\n"
                       "Serving Cell/Source: location only\n"
                       "Serving Cell/Cell ID: 13828438\n"
                       "Signal/LTE RSRP: -95.0 dBm\n"
                       "Serving Cell/RSRP: -110.0 dBm\n"
                       "Serving Cell/Cell ID: 13828609\n"
                       "Serving Cell/TAC: 33998\n"
                       "Registration/State: searching\n"
                       "Registration/State: roaming\n"
                       "Modem/State: unplugged\n"
                       "Modem/Model: AT-9\n"
                       "Modem/State: disabled\n"
                       "Modem/Model: AT-9\n");
}

TEST_F(ModemWorld, TheStreamGoesOnWhenModemManagerIsKilledAndRestarted) {
    const auto run = in("at-world", R"steps(
        begin_pallax modem --print
        shows "Modem/State: registered"
        kill -KILL "$(modem_manager_pid)"
        shows "Modem/State: ModemManager is not running"
        /usr/sbin/ModemManager --test-enable --test-no-udev --test-no-qrtr \
            --test-no-suspend-resume --no-auto-scan >"$folder/mm.log" 2>&1 &
        manager=$!
        until mmcli -L >"$folder/list" 2>&1; do sleep 0.1; done
        echo plug >"$WORLD/a.control"
        shows "Modem/State: disabled"
        mmcli -m any -e >"$folder/enabled"
        shows "Registration/State: home"
        kill $manager
        end_pallax)steps");
    EXPECT_EQ(run.out, "Modem/State: registered\n"
                       "Modem/State: ModemManager is not running\n"
                       "Modem/State: disabled\n"
                       "Registration/State: home\n");
}

TEST_F(ModemWorld, TwoModemsAreListedAndEachCanBeBrowsed) {
    const auto run = in("at-world --modem a --modem b=umts", R"steps(
        "$PALLAX" modem --list | wc -l
        begin_pallax modem 1 --print
        shows "Registration/Technology: UMTS"
        shows "Signal/UMTS RSCP: -95.0 dBm"
        end_pallax
        "$PALLAX" modem 7 --print; echo "status $?")steps");
    EXPECT_EQ(run.out, "3\n"
                       "Registration/Technology: UMTS\n"
                       "Signal/UMTS RSCP: -95.0 dBm\n"
                       "pallax: There is no modem \"7\": ModemManager has 0 (AT-9), 1 (AT-9).\n"
                       "status 1\n");
}

TEST_F(ModemWorld, WithoutRightsThePictureSaysWhy) {
    const auto run = in("at-world", R"steps(
        gdbus call --system --dest org.freedesktop.PolicyKit1 \
            --object-path /org/freedesktop/PolicyKit1/Authority \
            --method org.freedesktop.DBus.Mock.AllowUnknown false
        begin_pallax modem --print
        shows "Signal/Levels: not permitted"
        shows "Signal/Quality: 64 %"
        shows "Serving Cell/Source: not permitted"
        end_pallax)steps");
    EXPECT_EQ(run.out, "()\n"
                       "Signal/Levels: not permitted\n"
                       "Signal/Quality: 64 %\n"
                       "Serving Cell/Source: not permitted\n");
}

constexpr const char* kWhatAnOrdinaryUserSees = R"steps(
        test "$(id -u)" = 0 && echo root
        begin_pallax modem --print
        shows "Modem/State: registered"
        shows "Registration/Operator: SampleNet"
        shows "Signal/LTE RSRP: -95.0 dBm"
        shows "Serving Cell/Cell ID: 13828438"
        shows "SIM/Operator Code: 26242"
        shows "Serving Cell/Cell Information: $CELLS"
        end_pallax
        "$PALLAX" modem --list | grep -c "cells not permitted")steps";

TEST_F(ModemWorld, AnOrdinaryUserSeesAllButCells) {
    const auto run = asOrdinaryUserIn(
        "at-world" + policy(), std::string("CELLS=\"not permitted\"") + kWhatAnOrdinaryUserSees);
    EXPECT_EQ(run.out, "Modem/State: registered\n"
                       "Registration/Operator: SampleNet\n"
                       "Signal/LTE RSRP: -95.0 dBm\n"
                       "Serving Cell/Cell ID: 13828438\n"
                       "SIM/Operator Code: 26242\n"
                       "Serving Cell/Cell Information: not permitted\n"
                       "1\n");
}

TEST_F(ModemWorld, WithThePrintedPolicyAnOrdinaryUserMayAskForCells) {
    // The question reaches ModemManager, which has no cells of an AT modem.
    const auto run = asOrdinaryUserIn("at-world" + printedPolicy() + policy(),
                                      std::string("CELLS=\"not supported by this modem\"") +
                                          kWhatAnOrdinaryUserSees);
    EXPECT_EQ(run.out, "Modem/State: registered\n"
                       "Registration/Operator: SampleNet\n"
                       "Signal/LTE RSRP: -95.0 dBm\n"
                       "Serving Cell/Cell ID: 13828438\n"
                       "SIM/Operator Code: 26242\n"
                       "Serving Cell/Cell Information: not supported by this modem\n"
                       "0\n");
}

TEST_F(ModemWorld, ARecordingIsMadeInOneStepAndTheRateIsPutBack) {
    const auto run = in("at-world", R"steps(
        rate() { mmcli -m any --signal-get | grep -o "rate: [0-9]*"; }
        rate
        begin_pallax record --modem "$folder/drive.pcapng"
        until [ "$(rate)" = "rate: 2" ]; do sleep 0.1; done
        rate
        sleep 3
        end_pallax >"$folder/told"
        rate
        "$PALLAX" decode "$folder/drive.pcapng" | grep -c "LTE RSRP.*-95.0 dBm")steps");
    EXPECT_EQ(run.out, "rate: 0\n"
                       "rate: 2\n"
                       "rate: 0\n"
                       "1\n");
}

TEST_F(ModemWorld, WithoutABusOrModemManagerOneSentenceTellsIt) {
    const auto noBus = runCommand(
        "DBUS_SYSTEM_BUS_ADDRESS=unix:path=/nonexistent/bus " PALLAX_PROGRAM " modem --list");
    EXPECT_EQ(noBus.out, "pallax: There is no system bus, through which ModemManager is asked.\n");
    EXPECT_EQ(noBus.status, 1);
    const auto noManager = in("at-world", R"steps(
        kill -KILL "$(modem_manager_pid)"
        sleep 0.3
        "$PALLAX" modem --list; echo "status $?"
        begin_pallax modem --print
        shows "Modem/State: ModemManager is not running"
        end_pallax
        begin_pallax record --modem "$folder/drive.pcapng"
        succeeds "[ -s $folder/err ]"
        end_pallax)steps");
    EXPECT_EQ(noManager.out, "pallax: ModemManager is not running.\n"
                             "status 1\n"
                             "Modem/State: ModemManager is not running\n"
                             "pallax: ModemManager is not running; Pallax waits for it.\n");
}

TEST_F(ModemWorld, AModemManagerThatHangsIsAskedAgain) {
    const auto run = in("at-world", R"steps(
        manager=$(modem_manager_pid)
        kill -STOP $manager
        begin_pallax record --modem "$folder/drive.pcapng"
        succeeds "[ -s $folder/err ]"
        kill -CONT $manager
        succeeds "grep -q SampleNet $folder/drive.pcapng"
        end_pallax)steps");
    EXPECT_EQ(run.out, "pallax: ModemManager does not answer; Pallax asks again.\n");
}

TEST_F(ModemWorld, AMockOfACdmaModemAndOfOneThatTellsNrCells) {
    const auto run = in("mock-modems.py --picture both --release 1.22", R"steps(
        begin_pallax modem 0 --print
        shows "Registration/1x: home"
        shows "Signal/EV-DO RSSI: -79.0 dBm"
        shows "Serving Cell/PN: 28"
        end_pallax
        begin_pallax modem "NR 9" --print
        shows "Registration/Operator: Other <Net> & Co"
        shows "Serving Cell/NR-ARFCN: 640000"
        shows "Serving Cell/Bandwidth: 100.0 MHz"
        shows "Serving Cell/RSRQ: -11.0 dB"
        end_pallax)steps");
    EXPECT_EQ(run.out, "Registration/1x: home\n"
                       "Signal/EV-DO RSSI: -79.0 dBm\n"
                       "Serving Cell/PN: 28\n"
                       "Registration/Operator: Other <Net> & Co\n"
                       "Serving Cell/NR-ARFCN: 640000\n"
                       "Serving Cell/Bandwidth: 100.0 MHz\n"
                       "Serving Cell/RSRQ: -11.0 dB\n");
}

TEST_F(ModemWorld, WhatNoModemManagerShouldTellIsSurvived) {
    const auto run = in("hostile-manager.py", R"steps(
        attack() { echo "$1" >"$WORLD/control"; }
        begin_pallax modem --print
        shows "Modem/Model: Sane 1"
        attack types
        shows "Signal/Quality: unknown"
        attack missing
        shows "Modem/State: unplugged"
        attack sane
        shows "Signal/LTE RSRP: -95.0 dBm"
        attack huge
        shows "Signal/LTE RSRP: -95.0 dBm"
        attack "crowd 1000"
        attack sane
        shows "Signal/LTE RSRP: -95.0 dBm"
        "$PALLAX" modem --list | grep -c Crowd
        attack gone
        attack "flood 20000"
        attack "level -71"
        shows "Signal/LTE RSRP: -71.0 dBm"
        memory=$(grep -h VmHWM "/proc/$(pgrep -P $pallax_pid)/status" | grep -o "[0-9]*")
        [ "$memory" -lt 100000 ] || echo "$memory KiB"
        end_pallax)steps");
    EXPECT_EQ(run.out, "Modem/Model: Sane 1\n"
                       "Signal/Quality: unknown\n"
                       "Modem/State: unplugged\n"
                       "Signal/LTE RSRP: -95.0 dBm\n"
                       "Signal/LTE RSRP: -95.0 dBm\n"
                       "Signal/LTE RSRP: -95.0 dBm\n"
                       "1000\n"
                       "Signal/LTE RSRP: -71.0 dBm\n");
}

TEST_F(ModemWorld, AFloodOfSignalsMakesOneMessageASecondForEachOfTwoClients) {
    const auto run = in("hostile-manager.py", R"steps(
        attack() { echo "$1" >"$WORLD/control"; }
        "$PALLAX" service --modem "Sane 1" 2>"$folder/service" &
        service=$!
        for client in 1 2; do
            "$PALLAX" record "$folder/$client.pcapng" 2>"$folder/$client" &
            clients="$clients $!"
        done
        until [ -s "$folder/1.pcapng" ] && [ -s "$folder/2.pcapng" ]; do sleep 0.1; done
        for turn in 1 2 3 4 5; do attack "flood 2000"; sleep 0.5; done
        attack "level -71"
        sleep 2
        kill -INT $clients
        wait $clients
        kill -INT $service
        wait $service
        for client in 1 2; do
            "$PALLAX" decode "$folder/$client.pcapng" | grep -c "LTE RSRP.*-71.0 dBm"
            "$PALLAX" sql "$folder/$client.pcapng" "select count(*) > 2, min(gap) >= 990000 from
                (select time - lag(time) over (order by packet) as gap from packet)" --format csv
        done)steps");
    const std::string ofOne = "1\ncount(*) > 2,min(gap) >= 990000\n1,1\n";
    EXPECT_EQ(run.out, ofOne + ofOne);
}

TEST_F(ModemWorld, TheStreamGoesOnWhenTheBusIsLostAndComesBack) {
    const auto run = in("hostile-manager.py", R"steps(
        export DBUS_SYSTEM_BUS_ADDRESS=unix:path=$folder/bus
        begin_bus() {
            dbus-daemon --session --nofork --nopidfile --address="$DBUS_SYSTEM_BUS_ADDRESS" &
            bus=$!
            until [ -S "$folder/bus" ]; do sleep 0.1; done
            "$WORLDS/mock-modems.py" --picture nr >"$folder/mock" 2>&1 &
            until mmcli -L 2>&1 | grep -q "NR 9"; do sleep 0.1; done
        } 2>"$folder/bus.log"
        begin_bus
        begin_pallax modem --print
        shows "Modem/State: registered"
        { kill -KILL $bus; wait $bus; } 2>"$folder/killed"
        rm "$folder/bus"
        shows "Modem/State: no system bus"
        begin_bus
        shows "Modem/State: registered"
        end_pallax
        kill $bus)steps");
    EXPECT_EQ(run.out, "Modem/State: registered\n"
                       "Modem/State: no system bus\n"
                       "Modem/State: registered\n");
}

TEST_F(ModemWorld, TheSampleOfAnMbimModemHasCellsWithBandFrequencyAndOperator) {
    const std::string sample = PALLAX_SOURCE_DIR "/samples/modem-mbim.pcapng";
    const auto status = runCommand(PALLAX_PROGRAM " status " + sample).out;
    for (const char* words :
         {"SampleNet 262-42", "eNodeB 54017 sector 87", "PCI 121", "EARFCN 1850 · band 3",
          "1870.0 MHz", "RSRP -104.0 dBm", "UARFCN 10713 PSC 212 -85.0 dBm"}) {
        EXPECT_NE(status.find(words), std::string::npos) << words << "\n" << status;
    }
    const auto events = runCommand(PALLAX_PROGRAM " events " + sample + " | cut -c 26-").out;
    EXPECT_EQ(events, "cell-change       serving cell 1850/120 → 1850/121 after 12 s\n"
                      "state-change      modem registered → searching\n"
                      "service-lost      registration lost: searching after 19 s\n"
                      "state-change      modem searching → registered\n"
                      "service-regained  registration regained: home after 6 s\n");
    const auto cells = runCommand(PALLAX_PROGRAM " sql " + sample +
                                  " \"select role, system, identity from cell\" --format csv")
                           .out;
    EXPECT_NE(cells.find("active,nr,\"PCI 501, NR-ARFCN 640000\""), std::string::npos) << cells;
}

#ifdef PALLAX_USER_NAMESPACES
TEST_F(ModemWorld, AnMbimModemTellsItsCells) {
    const auto run = in("mbim-world", R"steps(
        begin_pallax modem --print
        shows "Serving Cell/Source: cell information"
        shows "Serving Cell/EARFCN: 1850"
        shows "Further Serving Cells/SINR: -3.0 dB"
        shows "Neighbour Cells/BSIC: 7,7"
        shows "Neighbour Cells/RSCP: -85.0 dBm"
        shows "Neighbour Cells/RSRQ: -15.5 dB"
        shows "Data Connections/APN: internet"
        shows "Signal/Levels: not supported by this modem"
        end_pallax)steps");
    EXPECT_EQ(run.out, "Serving Cell/Source: cell information\n"
                       "Serving Cell/EARFCN: 1850\n"
                       "Further Serving Cells/SINR: -3.0 dB\n"
                       "Neighbour Cells/BSIC: 7,7\n"
                       "Neighbour Cells/RSCP: -85.0 dBm\n"
                       "Neighbour Cells/RSRQ: -15.5 dB\n"
                       "Data Connections/APN: internet\n"
                       "Signal/Levels: not supported by this modem\n");
}
#endif

} // namespace
} // namespace pallax
