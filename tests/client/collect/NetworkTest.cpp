#include <gtest/gtest.h>

#include "client/collect/read/ReadNetwork.h"

namespace NORVZEL20 {

namespace {

std::string WithFaults(const std::string& text, const TReadFaults& faults)
{
    return faults.GetCount() == 0 ? text : text + std::to_string(faults.GetCount()) + " bad: " + faults.GetFirst() + "\n";
}

std::string RoutesText(std::vector<TRoute> (*read)(std::string_view, TReadFaults&), const std::string& table)
{
    TReadFaults faults;
    std::string text;
    for (const TRoute& route : read(table, faults)) {
        text += route.network + " " + route.interface + " " + std::to_string(route.metric) + " " + route.nextHop +
                (route.isRefused ? "refused" : "") + "\n";
    }
    return WithFaults(text, faults);
}

std::string SocketsText(const std::string& table)
{
    TReadFaults faults;
    std::string text;
    for (const TSocket& socket : ReadSockets("heading\n" + table, faults)) {
        text +=
            socket.address + " " + std::to_string(socket.port) + " " + socket.userId + " " + std::to_string(socket.inode) + "\n";
    }
    return WithFaults(text, faults);
}

}  // namespace

TEST(NetworkTablesTest, RoutesHaveNetworkAndRouter)
{
    EXPECT_EQ("0.0.0.0/0 eth0 100 192.168.1.1\n"
              "192.168.1.0/24 eth0 100 \n"
              "10.0.0.0/8 * 0 refused\n"
              "10.1.0.0/16 * 0 refused\n"
              "1 bad: line 6: found \"eth0 0002A8C0 00000000 0001\", expected a route\n",
              RoutesText(&ReadRoutes4, "Iface\tDestination\tGateway \tFlags\tRefCnt\tUse\tMetric\tMask\t\tMTU\tWindow\tIRTT\n"
                                       "eth0\t00000000\t0101A8C0\t0003\t0\t0\t100\t00000000\t0\t0\t0\n"
                                       "eth0\t0001A8C0\t00000000\t0001\t0\t0\t100\t00FFFFFF\t0\t0\t0\n"
                                       "*\t0000000A\t00000000\t0201\t0\t0\t0\t000000FF\t0\t0\t0\n"
                                       "*\t0000010A\t00000000\t0001\t0\t0\t0\t0000FFFF\t0\t0\t0\n"
                                       "eth0 0002A8C0 00000000 0001\n"));
}

TEST(NetworkTablesTest, RoutesOfIPv6LeaveOutWhatTheKernelMakes)
{
    const std::string zero(32, '0');
    EXPECT_EQ("2001:db8::/64 eth0 256 \n"
              "::/0 eth0 1024 fe80::1\n"
              "2001:db8:1::/48 lo 1024 refused\n"
              "1 bad: line 7: found \"rubbish\", expected a route\n",
              RoutesText(&ReadRoutes6,
                         "20010db8000000000000000000000000 40 " + zero + " 00 " + zero +
                             " 00000100 00000001 00000000 00000001     eth0\n" + zero + " 00 " + zero +
                             " 00 fe800000000000000000000000000001 00000400 00000003 00000000 00000003     eth0\n" +
                             "20010db8000000000000000000000005 80 " + zero + " 00 " + zero +
                             " 00000000 00000002 00000000 80200001     eth0\n" + "ff000000000000000000000000000000 08 " + zero +
                             " 00 " + zero + " 00000100 00000003 00000000 00000001     eth0\n" + zero + " 00 " + zero + " 00 " +
                             zero + " ffffffff 00000001 00000000 00200200       lo\n" + "20010db8000100000000000000000000 30 " +
                             zero + " 00 " + zero + " 00000400 00000002 00000000 00200200       lo\n" + "rubbish\n"));
}

TEST(NetworkTablesTest, AddressesOfIPv6LeaveOutTemporaryAndLinkLocalOnes)
{
    TReadFaults faults;
    std::string text;
    for (const TInterfaceAddress& address : ReadAddresses6("00000000000000000000000000000001 01 80 10 80       lo\n"
                                                           "fe800000000000005054fffffe123456 02 40 20 80     eth0\n"
                                                           "20010db8000000000000000000000005 02 40 00 80     eth0\n"
                                                           "20010db80000000000000000deadbeef 02 40 00 01     eth0\n"
                                                           "20010db8000000000000000000000g05 02 40 00 80     eth0\n",
                                                           faults)) {
        text += address.interface + " " + address.address + "\n";
    }
    EXPECT_EQ("lo ::1/128\neth0 2001:db8::5/64\n"
              "1 bad: line 5: found \"20010db8000000000000000000000g05 02 40 0...\", expected an address\n",
              WithFaults(text, faults));
}

TEST(NetworkTablesTest, SocketsThatListenHaveAddressAndPort)
{
    EXPECT_EQ("0.0.0.0 22 0 17291\n"
              "127.0.0.1 631 7 18000\n"
              "::ffff:127.0.0.1 8080 1000 19000\n"
              "0.0.0.0 68 0 20000\n",
              SocketsText("   0: 00000000:0016 00000000:0000 0A 00000000:00000000 00:00000000 00000000     0        0 17291 1 "
                          "0000000000000000 100 0 0 10 0\n"
                          "   1: 0100007F:0277 00000000:0000 0A 00000000:00000000 00:00000000 00000000     7        0 18000 1\n"
                          "   2: 0501A8C0:0016 0601A8C0:D431 01 00000000:00000000 02:000A7B8A 00000000     0        0 18500 4\n"
                          "   3: 0000000000000000FFFF00000100007F:1F90 00000000000000000000000000000000:0000 0A 00000000:00000000 "
                          "00:00000000 00000000  1000        0 19000 1\n"
                          " 100: 00000000:0044 00000000:0000 07 00000000:00000000 00:00000000 00000000     0        0 20000 2\n"));
}

TEST(NetworkTablesTest, BadRowsOfSocketsAreLeftOut)
{
    const char* const rows[] = {
        "0: 00000000:0016 00000000:0000 0A 0:0 0:0 0 0 0",       "0: 00000000 00000000:0000 0A 0:0 0:0 0 0 0 1 1",
        "0: 0000:0016 00000000:0000 0A 0:0 0:0 0 0 0 1 1",       "0: 00000000:10016 00000000:0000 0A 0:0 0:0 0 0 0 1 1",
        "0: 00000000:0016 00000000:0000 0A 0:0 0:0 0 0 0 one 1", "0: 0000000x:0016 00000000:0000 0A 0:0 0:0 0 0 0 1 1",
    };
    for (const std::string row : rows) {
        EXPECT_EQ("1 bad: line 2: found \"" + row.substr(0, 40) + (row.size() > 40 ? "...\"" : "\"") + ", expected a socket\n",
                  SocketsText(row));
    }
}

}  // namespace NORVZEL20
