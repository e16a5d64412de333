"""What the checks fetch is fetched once, and what goes wrong is said in a sentence."""
import hashlib
import os
import tarfile
import tempfile
import unittest
from pathlib import Path
from unittest import mock

import support
from macos import fetched, known


NO_NETWORK = """npm error code EAI_AGAIN
npm error syscall getaddrinfo
npm error errno EAI_AGAIN
npm error request to https://registry.npmjs.org/some failed, reason: getaddrinfo EAI_AGAIN registry.npmjs.org
npm error A complete log of this run can be found in: /home/some/.npm/_logs/debug-0.log
"""


class Fetching(unittest.TestCase):
    def setUp(self):
        scratch = tempfile.TemporaryDirectory()
        self.addCleanup(scratch.cleanup)
        self.scratch = Path(scratch.name)
        (self.scratch / "package").mkdir()
        (self.scratch / "package/one.txt").write_text("one")
        (self.scratch / "package/other.txt").write_text("other")
        with tarfile.open(self.scratch / "archive.tgz", "w:gz") as tar:
            tar.add(self.scratch / "package", "package")
        self.sum = hashlib.sha256((self.scratch / "archive.tgz").read_bytes()).hexdigest()

    def fetch(self, npm, checksum=None):
        """With a program of ours in the place of npm."""
        program = self.scratch / "bin/npm"
        program.parent.mkdir(exist_ok=True)
        program.write_text(f"#!/bin/sh\necho asked >>{self.scratch}/asked\n{npm}\n")
        program.chmod(0o755)
        packages = (("some@1", checksum or self.sum, (("package/one.txt", "texts/1"),)),)
        with mock.patch.object(fetched, "PACKAGES", packages), \
                mock.patch.dict(os.environ, PATH=f"{program.parent}:/usr/bin:/bin"):
            fetched.fetch(self.scratch / "fetched")

    def asked(self):
        return len((self.scratch / "asked").read_text().splitlines())

    def copying(self):
        return f"cp {self.scratch}/archive.tgz ."

    def test_what_is_needed_is_kept_and_not_asked_for_again(self):
        self.fetch(self.copying())
        self.fetch("exit 1")
        self.assertEqual(self.asked(), 1)
        self.assertEqual((self.scratch / "fetched/texts/1").read_text(), "one")
        self.assertEqual([path.name for path in (self.scratch / "fetched").rglob("*.txt")], [])

    def test_without_a_network_a_person_is_told_what_to_do(self):
        with self.assertRaises(SystemExit) as raised:
            self.fetch(f"cat >&2 <<'END'\n{NO_NETWORK}END\nexit 1")
        self.assertEqual(str(raised.exception), "The checks for macOS need some@1 from the npm registry, once, and it could not "
                         "be fetched: getaddrinfo EAI_AGAIN registry.npmjs.org. Connect this machine, and run ./test again.")
        self.assertEqual(list(self.scratch.glob("fetched*")), [])

    def test_npm_itself_gives_a_reason(self):
        with tempfile.TemporaryDirectory() as home, \
                mock.patch.dict(os.environ, HOME=home, npm_config_registry="http://127.0.0.1:9/"), \
                self.assertRaises(SystemExit) as raised:
            fetched.fetch(self.scratch / "fetched")
        self.assertIn("could not be fetched: connect ECONNREFUSED 127.0.0.1:9. Connect", str(raised.exception))

    def test_what_npm_says_in_other_ways_is_told_too(self):
        self.assertEqual(fetched.reason_of("npm ERR! code ETARGET\nnpm ERR! notarget No matching version found for some@1.\n"),
                         "notarget No matching version found for some@1.")
        self.assertEqual(fetched.reason_of(""), "npm gives no reason")

    def test_what_is_there_stays_until_its_successor_is(self):
        self.fetch(self.copying())
        (self.scratch / "fetched/complete").write_text("of another choice")
        with self.assertRaises(SystemExit):
            self.fetch("exit 1")
        self.assertTrue((self.scratch / "fetched/texts/1").exists())

    def test_another_archive_than_was_meant_is_refused(self):
        with self.assertRaises(SystemExit) as raised:
            self.fetch(self.copying(), checksum="0" * 64)
        self.assertEqual(str(raised.exception), f"some@1 is not what it was: its checksum is {self.sum}, and not {'0' * 64}.")

    def test_after_a_failure_it_is_tried_again(self):
        with self.assertRaises(SystemExit):
            self.fetch("exit 1")
        self.fetch(self.copying())
        self.assertEqual((self.scratch / "fetched/texts/1").read_text(), "one")

    def test_npm_is_asked_for_by_name(self):
        with mock.patch.object(fetched.shutil, "which", return_value=None), self.assertRaises(SystemExit) as raised:
            fetched.fetch(self.scratch / "fetched")
        self.assertIn("npm, which tools/setup installs", str(raised.exception))


class Licences(unittest.TestCase):
    def test_they_stand_beside_what_was_fetched_and_what_is_made_of_it(self):
        for folder in ("fetched", "MacOSX.sdk"):
            texts = {path.name: path.read_text(encoding="utf-8") for path in (support.BUILD / folder / "licences").iterdir()}
            self.assertEqual(sorted(texts), ["libcxx", "libcxxabi", "macos-node-api", "zig"])
            self.assertIn("Permission is hereby granted, free of charge", texts["macos-node-api"])


class KnownFaults(unittest.TestCase):
    TEXT = "layouts a.xib: one\nlayouts a.xib: two\nother b: three\n"

    def test_they_are_told_and_do_not_fail(self):
        wanted = known.known_faults(self.TEXT, "layouts")
        self.assertEqual(wanted, {"a.xib: one", "a.xib: two"})
        passes, said = known.judged("layouts", ["a.xib: one", "a.xib: two"], wanted)
        self.assertTrue(passes)
        self.assertEqual(said[0], "Known, and not mended yet: a.xib: one")

    def test_a_new_fault_fails(self):
        passes, said = known.judged("layouts", ["a.xib: one", "new"], {"a.xib: one"})
        self.assertFalse(passes)
        self.assertIn("new", said)

    def test_a_mended_fault_has_to_be_taken_out(self):
        passes, said = known.judged("layouts", [], {"a.xib: one"})
        self.assertFalse(passes)
        self.assertEqual(said, ["Mended, and to be taken out of tools/macos/known_faults.txt: a.xib: one"])


if __name__ == "__main__":
    unittest.main()
