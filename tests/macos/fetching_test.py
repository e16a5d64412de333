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
            self.fetch("echo 'getaddrinfo failed' >&2; exit 1")
        self.assertEqual(str(raised.exception), "The checks for macOS need some@1 from the npm registry, once, and it could not "
                         "be fetched: getaddrinfo failed. Connect this machine, and run ./test again.")
        self.assertFalse((self.scratch / "fetched").exists())

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
