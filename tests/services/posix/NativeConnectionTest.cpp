// How FreeTDS is told where the database is.
#include "varnex3/services/NativeConnection.h"

#include "tests/Printing.h"
#include "varnex3/services/DriverConnection.h"
#include "varnex3/services/InstanceLookup.h"

using namespace varnex3;
using namespace std::string_literals;

TEST_CASE("The server part is taken apart into host, instance and port")
{
    struct Row
    {
        TextView serverPart;
        ServerAddress address;
    };
    for (const Row& row :
         {Row{u"(local)\\", {u"127.0.0.1", u"", u""}}, Row{u"(LOCAL)\\SQLEXPRESS", {u"127.0.0.1", u"SQLEXPRESS", u""}},
          Row{u".\\", {u"127.0.0.1", u"", u""}}, Row{u"localhost\\", {u"127.0.0.1", u"", u""}},
          Row{u"\\", {u"127.0.0.1", u"", u""}}, Row{u"SRV\\", {u"SRV", u"", u""}}, Row{u"SRV\\X", {u"SRV", u"X", u""}},
          Row{u"SRV\\X\\", {u"SRV", u"X", u""}}, Row{u"SRV,14330\\", {u"SRV", u"", u"14330"}},
          Row{u"SRV, 14330\\X", {u"SRV", u"X", u"14330"}}, Row{u"SRV\\X,14330\\", {u"SRV", u"X", u"14330"}},
          Row{u"10.0.0.7\\", {u"10.0.0.7", u"", u""}}}) {
        CAPTURE(ToUtf8(row.serverPart));
        CHECK(AddressOf(row.serverPart) == row.address);
    }
}

TEST_CASE("The driver's string pins the protocol and asks for UTF-8; a semicolon is part of a value")
{
    const ConnectionSettings settings{u"a;b", u"Crv;Server=x", u"SRV", u""};
    CHECK(NativeConnectionString(settings, u"SQL Server", u"10.0.0.7", u"1433")
          == u"Driver={SQL Server};Server=10.0.0.7;Port=1433;Database={Crv;Server=x};Uid=sa;Pwd={a;b};"
             u"TDS_Version=7.3;ClientCharset=UTF-8;");
}

TEST_CASE("The password is hidden wherever it occurs")
{
    CHECK(WithoutPassword(u"login with s3 failed: s3", u"s3") == u"login with *** failed: ***");
    CHECK(WithoutPassword(u"no password", u"") == u"no password");
    CHECK(WithoutPassword(u"**", u"*") == u"******");
}

TEST_CASE("The answer about an instance tells its port, or nothing when it is of another form")
{
    const std::string facts = "ServerName;SRV;InstanceName;X;tcp;14330;;";
    CHECK(PortFromAnswer("\5\0\0"s + facts) == 14330);
    CHECK(PortFromAnswer("\5\0\0"s + "ServerName;tcp;np;x;tcp;7"s) == 7);
    for (const std::string& answer :
         {""s, "\5"s, "\5\0\0"s, "\4\0\0"s + facts, "\5\0\0tcp"s, "\5\0\0tcp;;"s, "\5\0\0tcp;0;"s, "\5\0\0tcp;65536;"s,
          "\5\0\0tcp;1x;"s, "\5\0\0tcp;-1;"s, "\5\0\0np;\\\\SRV;;"s})
        CHECK_FALSE(PortFromAnswer(answer).has_value());
}

TEST_CASE("Numeric addresses are hosts as they are; a name that is none is no host")
{
    CHECK(ResolveHost("127.0.0.1") == "127.0.0.1");
    CHECK(ResolveHost("::1") == "::1");
    CHECK_FALSE(ResolveHost("no host at all").has_value());
}
