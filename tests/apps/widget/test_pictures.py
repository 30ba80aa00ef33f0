"""Pictures and dumps of the demonstration city: their sizes, what they say of themselves, and where they fail."""

import struct
import unittest
import zlib

from widget_support import AT, WidgetTest


def chunks(png):
    """The chunks of a PNG file, by their kind."""
    found, at = {}, 8
    while at < len(png):
        (length,) = struct.unpack(">I", png[at:at + 4])
        kind = png[at + 4:at + 8].decode()
        found[kind] = found.get(kind, b"") + png[at + 8:at + 8 + length]
        at += 12 + length
    return found


class Pictures(WidgetTest):
    def picture(self, *words):
        path = self.home / "card.png"
        self.widget("--demo", "--at", AT, "--snapshot", path, *words)
        return chunks(path.read_bytes())

    def size(self, *words):
        return struct.unpack(">II", self.picture(*words)["IHDR"][:8])

    def test_is_as_large_as_the_card_in_pixels_of_the_scale(self):
        self.assertEqual(self.size("--mode", "compact"), (359, 146))
        self.assertEqual(self.size("--mode", "expanded"), (359, 586))
        self.assertEqual(self.size("--mode", "compact", "--scale", "3"), (1077, 438))
        self.assertEqual(self.size("--mode", "compact", "--width", "300"), (300, 146))

    def test_every_row_fits_at_the_largest_text_size(self):
        self.assertEqual(self.size("--text-size", "AX5"), (359, 36 + 5 * 343))

    def test_says_how_large_a_pixel_is(self):
        for scale in (1, 2, 3):
            across, down, unit = struct.unpack(">IIB", self.picture("--mode", "compact", "--scale", scale)["pHYs"])
            self.assertEqual((across, down, unit), (round(72 * scale / 0.0254), round(72 * scale / 0.0254), 1))

    def test_looks_differ(self):
        looks = [(), ("--dark",), ("--contrast",), ("--dark", "--contrast"), ("--language", "ar"), ("--text-size", "XL")]
        pictures = {zlib.decompress(self.picture("--mode", "compact", *look)["IDAT"]) for look in looks}
        self.assertEqual(len(pictures), len(looks))

    def test_the_same_picture_comes_out_the_same(self):
        self.assertEqual(self.picture(), self.picture())

    def test_a_file_that_cannot_be_written_is_named_and_nothing_is_left(self):
        path = self.home / "none" / "card.png"
        answer = self.widget_refused(1, "--demo", "--at", AT, "--snapshot", path)
        self.assertEqual(answer.err, f"orvo-transit-widget: {path}: No such file or directory\n")

    def test_dumps_are_text(self):
        self.assertTrue(self.widget("--demo", "--at", AT, "--dump", "views").out.startswith("WidgetCard1 0 0 359 586\n"))
        self.assertIn("row 4: OWTransitItemFixedHeightCell\n",
                      self.widget("--demo", "--at", AT, "--dump", "constraints").out)
        self.assertIn("TransitStorageLineItem", self.widget("--demo", "--at", AT, "--dump", "archive").out)


if __name__ == "__main__":
    unittest.main()
