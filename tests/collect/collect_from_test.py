#!/usr/bin/env python3
"""Runs `cimdelta collect --from` against servers that are made of inventories, and against recorded answers.

Arguments: ROOT CIMDELTA. Needs openssl.
"""
import os
import signal
import socket
import subprocess
import sys
import time
import unittest

import made_server
from collecting import CIMDELTA, DATA, RECORDINGS, ROOT, SMALL, TCollect, document


class CollectedTest(TCollect):
    """What is collected is what the server has."""

    def assert_same(self, path, **how):
        text = path.read_text()
        for has_pull in (True, False):
            with self.subTest(path=path.name, has_pull=has_pull):
                server = self.serve({"root/cimv2": text}, has_pull=has_pull, **how)
                self.assert_collected(server, "--timeout", "20")
                result = self.run_program("compare", "--namespace", "root/cimv2", path, "out.xml")
                self.assertIn("No differences between", result.stdout, result.stderr)
                self.assertEqual(0, result.returncode)
                self.assertEqual(has_pull, not any(call.startswith("EnumerateInstances ") for call in server.calls))

    def test_inventories_come_as_they_are(self):
        self.assert_same(ROOT / "data/examples/bookworm.xml")
        self.assert_same(DATA / "typepair/A.xml")
        self.assert_same(DATA / "interchange-openpegasus/root_deb/inventory.xml")
        self.assert_same(DATA / "interchange-pywbem/04-all-in-one.xml", host="peer.example.com:5989")

    def test_a_copy_is_the_same_byte_for_byte_whatever_the_transfer(self):
        server = self.serve()
        self.assert_collected(server)
        plain = (self.folder / "out.xml").read_bytes()
        server.misbehave("*", "*", made_server.chunked)
        for operation in ("EnumerateClasses", "OpenEnumerateInstances"):
            server.misbehave(operation, "*", made_server.chunked)
        self.assert_collected(server)
        self.assertEqual(plain, (self.folder / "out.xml").read_bytes())

    def test_many_instances_come_in_parts(self):
        server = self.serve({"root/cimv2": document("Disk", instances=[("Disk", str(i)) for i in range(2500)])})
        self.assert_collected(server)
        self.assertEqual("Disk: 2500 instances\n", self.shown())
        self.assertEqual(["EnumerateClasses", "EnumerateQualifiers", "OpenEnumerateInstances Disk"] + ["PullInstancesWithPath Disk"] * 2, server.calls)

    def test_without_a_file_the_inventory_goes_to_standard_output(self):
        server = self.serve()
        result = self.run_program("collect", "--from", server.url)
        self.assertEqual((0, ""), (result.returncode, result.stderr))
        self.assertIn("<INSTANCE CLASSNAME=\"Disk\">", result.stdout)
        self.assertEqual([], self.files())

    def test_a_failed_collection_leaves_the_file_that_was_there(self):
        (self.folder / "out.xml").write_text("before")
        server = self.serve()
        server.misbehave("EnumerateClasses", "", made_server.cim_error(1, "no"))
        self.assertEqual("cimdelta: SERVER: EnumerateClasses of root/cimv2: CIM_ERR_FAILED (1), \"no\"\n", self.collect(server))
        self.assertEqual("before", (self.folder / "out.xml").read_text())
        self.assertEqual(["out.xml"], self.files())


class RecordedTest(TCollect):
    """Recorded answers of another server, over HTTP."""

    NAMESPACE = ("--namespace", "/root/deb/")

    def trust(self):
        """Further arguments."""
        return ()

    def sources(self, recordings):
        return ",".join(str(next((DATA / "wire").glob(recording + ".response*"))) for recording in recordings)

    def assert_collected_recordings(self, server, **environment):
        self.assert_collected(server, *self.NAMESPACE, *self.trust(), **environment)
        result = self.run_program("compare", self.sources(RECORDINGS), "out.xml")
        self.assertIn("No differences between", result.stdout, result.stderr)
        (self.folder / "out.xml").unlink()

    def test_they_become_an_inventory(self):
        server = self.serve_recordings()
        self.assert_collected_recordings(server)
        self.assertEqual(["EnumerateClasses", "EnumerateQualifiers", "OpenEnumerateInstances DEB_PackageDependency",
                          "EnumerateInstances DEB_PackageDependency", "EnumerateInstances DEB_Package"], server.calls)

    def test_a_recorded_sequence_of_parts_is_read_to_its_end(self):
        recordings = ("025-pywbem-EnumerateClasses", "036-pywbem-OpenEnumerateInstances-Pull")
        server = self.serve_recordings(recordings)
        server.misbehave("OpenEnumerateInstances", "DEB_PackageDependency", made_server.cim_error(1, "not recorded"))
        self.assertEqual('cimdelta: not collected from root/deb: instances of DEB_PackageDependency: CIM_ERR_FAILED (1), "not recorded"\n',
                         self.collect(server, *self.NAMESPACE, *self.trust()))
        self.assertEqual(["OpenEnumerateInstances DEB_Package"] + ["PullInstancesWithPath"] * 3, server.calls[-4:])
        packages = self.run_program("show", "out.xml", "DEB_Package").stdout
        self.assertEqual(self.run_program("show", self.sources(recordings), "DEB_Package").stdout, packages)
        self.assertEqual(94, packages.count("\nDEB_Package.") + 1)

    def test_in_chunks_too(self):
        server = self.serve_recordings()
        for operation in ("EnumerateClasses", "EnumerateQualifiers", "EnumerateInstances"):
            server.misbehave(operation, "*", made_server.chunked)
        self.assert_collected_recordings(server)

    def test_a_cut_answer_is_asked_for_again(self):
        for act in (made_server.cut, made_server.cut_chunk, made_server.cut_xml):
            server = self.serve_recordings()
            server.misbehave("EnumerateInstances", "DEB_PackageDependency", act, times=1)
            self.assert_collected_recordings(server)
            self.assertEqual(2, server.calls.count("EnumerateInstances DEB_PackageDependency"))

    def test_errors_slowness_and_wrong_passwords_have_messages(self):
        server = self.serve_recordings(user=("me", "right"))
        server.misbehave("EnumerateClasses", "", made_server.cim_error(1, "x"), times=1)
        server.misbehave("EnumerateClasses", "", made_server.silent, times=1)
        right = {"CIMDELTA_USER": "me", "CIMDELTA_PASSWORD": "right"}
        for password, message in (("right", 'SERVER: EnumerateClasses of root/deb: CIM_ERR_FAILED (1), "x"'),
                                  ("right", "SERVER: the server was silent for 1 s; allow it more with --timeout SECONDS"),
                                  ("wrong", 'SERVER: the server refuses user "me" with this password (HTTP 401 Unauthorized); correct CIMDELTA_USER and'
                                            " CIMDELTA_PASSWORD")):
            self.assert_refused("cimdelta: " + message, server, *self.NAMESPACE, *self.trust(), "--timeout", "1", **dict(right, CIMDELTA_PASSWORD=password))
        self.assert_collected_recordings(server, **right)


class RecordedOverTlsTest(RecordedTest):
    """The same over TLS."""

    def serve_recordings(self, *recordings, **how):
        return super().serve_recordings(*recordings, certificate=self.certificate(), **how)

    def trust(self):
        return "--ca", str(self.folder / "cert.pem")

    def test_a_wrong_certificate_is_refused(self):
        server = self.serve_recordings()
        message = self.collect(server, *self.NAMESPACE)
        self.assertIn("found a certificate of an authority that is not known here", message)
        self.assertEqual([], server.calls)


class NotCollectedTest(TCollect):
    def test_what_could_not_be_read_is_named_in_the_inventory_and_its_siblings_are_there(self):
        server = self.serve()
        for subject in ("Top", "Fan"):
            server.misbehave("OpenEnumerateInstances", subject, made_server.cim_error(1, "the provider crashed"))
        self.assertEqual('cimdelta: not collected from root/cimv2: instances of Fan: CIM_ERR_FAILED (1), "the provider crashed"\n', self.collect(server))
        self.assertEqual(0, self.result.returncode)
        self.assertEqual("Top: 0 instances\n  Disk: 2 instances\n  Fan: 0 instances\n  Volume: 1 instance\nKALMO_NotCollected: 1 instance\n", self.shown())

    def test_each_way_to_fail_costs_one_class(self):
        rows = [(made_server.http_status(500), "found HTTP 500 Internal Server Error, expected an answer of CIM"),
                (made_server.cut_xml, "found an answer that ends early"),
                (made_server.body("<html>"), "found a web page, expected CIM-XML; is this the port of a WBEM server? Those are usually 5989 (https) and 5988 (http)"),
                (made_server.changed('NAME="Id" TYPE="string"', 'NAME="Id" TYPE="nonsense"'), None)]
        for act, reason in rows:
            with self.subTest(reason=reason):
                server = self.serve()
                server.misbehave("OpenEnumerateInstances", "Top", made_server.cim_error(1, "x"))
                server.misbehave("OpenEnumerateInstances", "Fan", act)
                message = self.collect(server)
                self.assertEqual(0, self.result.returncode, message)
                self.assertTrue(message.startswith("cimdelta: not collected from root/cimv2: instances of Fan: "), message)
                if reason:
                    self.assertIn(reason, message)
                self.assertIn("Disk: 2 instances", self.shown())
                self.assertIn("Fan: 0 instances", self.shown())
                (self.folder / "out.xml").unlink()

    def test_a_silent_provider_costs_its_class(self):
        server = self.serve()
        server.misbehave("OpenEnumerateInstances", "Top", made_server.cim_error(1, "x"))
        server.misbehave("OpenEnumerateInstances", "Fan", made_server.silent)
        self.assertEqual("cimdelta: not collected from root/cimv2: instances of Fan: the server was silent for 1 s; allow it more with --timeout SECONDS\n",
                         self.collect(server, "--timeout", "1"))

    def test_later_reports_say_what_an_inventory_lacks(self):
        server = self.serve()
        self.assert_collected(server)
        (self.folder / "out.xml").rename(self.folder / "whole.xml")
        for subject in ("Top", "Fan"):
            server.misbehave("OpenEnumerateInstances", subject, made_server.cim_error(1, "crashed"))
        self.collect(server)
        report = self.run_program("compare", "whole.xml", "out.xml")
        self.assertIn('out was collected without instances: Fan (CIM_ERR_FAILED (1), "crashed")', report.stdout)


class RetryTest(TCollect):
    def test_a_busy_server_is_asked_again(self):
        server = self.serve()
        server.misbehave("EnumerateClasses", "", made_server.http_status(503), times=1)
        self.assert_collected(server)
        self.assertEqual(2, server.calls.count("EnumerateClasses"))

    def test_so_is_one_whose_answer_is_cut(self):
        for act in (made_server.cut, made_server.cut_chunk, made_server.cut_xml):
            server = self.serve()
            server.misbehave("EnumerateQualifiers", "", act, times=1)
            self.assert_collected(server)
            self.assertEqual(2, server.calls.count("EnumerateQualifiers"))

    def test_a_lost_answer_to_pull_begins_the_enumeration_anew(self):
        server = self.serve({"root/cimv2": document("Disk", instances=[("Disk", str(i)) for i in range(1500)])})
        server.misbehave("PullInstancesWithPath", "Disk", made_server.cut, times=1)
        self.assert_collected(server)
        self.assertEqual("Disk: 1500 instances\n", self.shown())
        self.assertEqual(2, server.calls.count("OpenEnumerateInstances Disk"))

    def test_tries_end(self):
        server = self.serve()
        server.misbehave("EnumerateClasses", "", made_server.cut)
        self.assert_refused("cimdelta: SERVER: the connection ended in the middle of an answer", server)
        self.assertEqual(4, server.calls.count("EnumerateClasses"))

    def test_errors_of_cim_and_refused_users_are_not_tried_again(self):
        server = self.serve()
        server.misbehave("EnumerateClasses", "", made_server.cim_error(2, "not you"))
        self.assert_refused('cimdelta: SERVER: EnumerateClasses of root/cimv2: CIM_ERR_ACCESS_DENIED (2), "not you"', server)
        self.assertEqual(["EnumerateClasses"], server.calls)


class LimitsTest(TCollect):
    """Nothing hangs, and nothing fills the memory."""

    def test_a_server_that_never_answers(self):
        server = self.serve()
        server.misbehave("EnumerateClasses", "", made_server.silent)
        self.assert_refused("cimdelta: SERVER: the server was silent for 1 s; allow it more with --timeout SECONDS", server, "--timeout", "1")

    def test_an_answer_that_trickles_without_end(self):
        server = self.serve()
        server.misbehave("EnumerateClasses", "", made_server.trickle)
        self.assert_refused("cimdelta: SERVER: the collection took more than 1 s; allow more with --time-limit SECONDS", server, "--time-limit", "1")

    def test_an_endless_answer(self):
        for limit, message in (("--size-limit", "found answers of more than 1 MiB; allow more with --size-limit MIB"),
                               ("--instance-limit", "found more than 1 instance; allow more with --instance-limit NUMBER")):
            server = self.serve(has_pull=False)
            server.misbehave("EnumerateInstances", "Top", made_server.endless)
            self.assert_refused("cimdelta: SERVER: " + message, server, limit, "1")

    def test_a_server_that_takes_the_connection_and_says_nothing_of_tls(self):
        with socket.create_server(("127.0.0.1", 0)) as listener:
            url = f"https://127.0.0.1:{listener.getsockname()[1]}"
            result = self.run_program("collect", "--from", url, "--timeout", "1")
            self.assertEqual((2, f"cimdelta: {url}: no connection within 1 s; is the server running, and is that its port?\n"), (result.returncode, result.stderr))


class WrongServerTest(TCollect):
    def test_nobody_listens(self):
        with socket.create_server(("127.0.0.1", 0)) as listener:
            url = f"http://127.0.0.1:{listener.getsockname()[1]}"
        result = self.run_program("collect", "--from", url, "-o", "out.xml")
        self.assertEqual((2, f"cimdelta: {url}: no connection: Connection refused; is the server running, and is that its port?\n"),
                         (result.returncode, result.stderr))

    def test_no_such_host(self):
        result = self.run_program("collect", "--from", "https://nowhere.invalid", "-o", "out.xml")
        self.assertEqual((2, "cimdelta: https://nowhere.invalid:5989: no address is known for nowhere.invalid; correct the name, or name the address itself\n"),
                         (result.returncode, result.stderr))

    def test_a_web_server(self):
        server = self.serve()
        server.misbehave("EnumerateClasses", "", made_server.body("<!DOCTYPE html><html><body>Welcome</body></html>"))
        self.assert_refused("cimdelta: SERVER: EnumerateClasses of root/cimv2: found a web page, expected CIM-XML; is this the port of a WBEM server? Those are"
                            " usually 5989 (https) and 5988 (http)", server)

    def test_statuses_of_http(self):
        for status, message in ((404, "SERVER/cimom: found nothing there (HTTP 404 Not Found); if the server answers at another path than /cimom, name it behind"
                                      " the port, and the namespace with --namespace"),
                                (403, "SERVER: the user may not ask (HTTP 403 Forbidden); ask as another one"),
                                (500, "SERVER: EnumerateClasses of root/cimv2: found HTTP 500 Internal Server Error, expected an answer of CIM")):
            server = self.serve()
            server.misbehave("EnumerateClasses", "", made_server.http_status(status))
            self.assert_refused("cimdelta: " + message, server)
            self.assertEqual(["EnumerateClasses"], server.calls)

    def test_a_redirection_is_not_followed(self):
        other, server = self.serve(), self.serve()
        server.misbehave("EnumerateClasses", "", made_server.http_status(302, Location=other.url + "/cimom"))
        self.assert_refused(f'cimdelta: SERVER: the server redirects to "{other.url}/cimom" (HTTP 302 Found); if you trust that address, name it with --from',
                            server)
        self.assertEqual([], other.calls)

    def test_a_namespace_that_is_not_there_is_answered_with_those_that_are(self):
        server = self.serve({"root/cimv2": SMALL, "root/interop": made_server.interop(["root/cimv2", "root/interop"])})
        self.assert_refused('cimdelta: SERVER: the server has no namespace "root/nothing"; it has root/cimv2, root/interop: name one of these with --namespace',
                            server, "--namespace", "root/nothing")
        server = self.serve()
        self.assert_refused('cimdelta: SERVER: the server has no namespace "nothing"; name another one with --namespace', server, "--namespace", "nothing")


class AllNamespacesTest(TCollect):
    NAMES = ["root/cimv2", "root/interop", "a_b"]

    def test_each_namespace_is_an_inventory_in_a_folder(self):
        server = self.serve({"root/cimv2": SMALL, "root/interop": made_server.interop(self.NAMES), "a_b": document("Disk", instances=[("Disk", "1")])})
        result = self.run_program("collect", "--from", server.url, "--all-namespaces", "-o", "array1")
        self.assertEqual((0, "", ""), (result.returncode, result.stdout, result.stderr))
        self.assertEqual(["a_b.xml", "root-cimv2.xml", "root-interop.xml"], sorted(os.listdir(self.folder / "array1")))
        self.assertEqual("Disk: 1 instance\n", self.shown("array1/a_b.xml"))
        self.assertEqual("CIM_Namespace: 3 instances\n", self.shown("array1/root-interop.xml"))

    def test_old_servers_name_their_namespaces_downwards(self):
        server = self.serve({"root": made_server.interop(["cimv2"], "__Namespace"), "root/cimv2": SMALL})
        result = self.run_program("collect", "--from", server.url, "--all-namespaces", "-o", "array1")
        self.assertEqual((0, "", ""), (result.returncode, result.stdout, result.stderr))
        self.assertEqual(["root-cimv2.xml"], os.listdir(self.folder / "array1"))

    def test_a_namespace_that_fails_leaves_the_others(self):
        server = self.serve({"root/cimv2": SMALL, "root/interop": made_server.interop(["root/cimv2", "root/gone"])})
        result = self.run_program("collect", "--from", server.url, "--all-namespaces", "-o", "array1")
        self.assertEqual((2, f'cimdelta: not collected: namespace root/gone: {server.url}: EnumerateClasses of root/gone: CIM_ERR_INVALID_NAMESPACE (3), "root/gone"\n'),
                         (result.returncode, result.stderr))
        self.assertEqual(["root-cimv2.xml", "root-interop.xml"], sorted(os.listdir(self.folder / "array1")))

    def test_a_server_may_not_say_its_namespaces(self):
        server = self.serve()
        result = self.run_program("collect", "--from", server.url, "--all-namespaces", "-o", "array1")
        self.assertEqual((2, f"cimdelta: {server.url}: the server does not say which namespaces it has (it was asked in root/interop, interop, root/PG_InterOp"
                             " and root); name one with --namespace\n"), (result.returncode, result.stderr))
        self.assertEqual([], self.files())

    def test_a_folder_with_something_in_it_is_left_alone(self):
        (self.folder / "array1").mkdir()
        (self.folder / "array1/a.xml").write_text("")
        server = self.serve()
        result = self.run_program("collect", "--from", server.url, "--all-namespaces", "-o", "array1")
        self.assertEqual((2, "cimdelta: array1: found something there, expected an empty folder or nothing; name another one with --output\n"),
                         (result.returncode, result.stderr))
        self.assertEqual([], server.calls)


class ProgressTest(TCollect):
    def test_a_waiting_person_sees_how_far_it_is(self):
        server = self.serve({"root/cimv2": document("Disk", "Fan", instances=[("Disk", "1"), ("Disk", "2"), ("Fan", "1")])})
        server.misbehave("OpenEnumerateInstances", "Fan", made_server.late)
        self.assertIn("collecting root/cimv2 from SERVER 1 of 2 classes, 2 instances, 0 MiB (1 s)", self.talk(server))
        self.assertEqual(0, self.status)


class InterruptedTest(TCollect):
    def test_an_interrupt_leaves_nothing_behind(self):
        server = self.serve()
        server.misbehave("OpenEnumerateInstances", "Top", made_server.silent)
        program = subprocess.Popen([CIMDELTA, "collect", "--from", server.url, "-o", "out.xml"], cwd=self.folder, env=self.environment)
        end = time.monotonic() + 60
        while "OpenEnumerateInstances Top" not in server.calls and time.monotonic() < end:
            time.sleep(0.01)
        program.send_signal(signal.SIGINT)
        self.assertEqual(-signal.SIGINT, program.wait(60))
        self.assertEqual([], self.files())

if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
