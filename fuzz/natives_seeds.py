#!/usr/bin/env python3
"""Writes seeds/natives: whole sessions, in the byte format that natives.cpp draws its calls from.

Values are drawn from the end of the input, the first drawn at the very end, each as an offset from the least value of
its range, in as many bytes as the range needs, high byte first. Each class below mirrors one function of natives.cpp.
"""
import pathlib

CALLS = ["transfer", "setUp", "setUpGpu", "loadTextures", "makeMesh", "moveWater", "ripple", "touch", "draw",
         "clearInk", "askForInk"]
DOWN, UP, MOVE, CANCEL = range(4)


class Session:
    def __init__(self):
        self.drawn = bytearray()

    def below(self, end, value):
        self.range(0, end - 1, value)

    def range(self, least, most, value):
        size = ((most - least).bit_length() + 7) // 8
        self.drawn += (value - least).to_bytes(size, "big")

    def number(self, least, most, value):
        self.below(256, 0)
        self.range(least, most, value)

    def absurd(self, value):
        self.below(256, 255)
        self.range(-2**31, 2**31 - 1, value)

    def real(self, value):
        self.below(256, 0)
        self.range(-32768, 32767, round(value * 256))

    def call(self, name):
        self.below(len(CALLS), CALLS.index(name))

    def there(self, *_):
        self.below(256, 0)

    def pictures(self):
        for slot in range(3):
            self.call("transfer")
            self.below(3, slot)
            self.below(16, 0)
            self.number(0, 16, 8)
            self.number(0, 16, 6)
            self.below(6, 0)
            self.number(1, 8, 1)
            self.below(16, 0)

    def set_up(self, width, height, ink):
        self.call("setUp")
        for side in (width, height):
            if side <= 243:
                self.number(-12, 243, side)
            else:
                self.absurd(side)
        self.below(4, int(ink))
        self.call("setUpGpu")
        for slot in range(3):
            self.call("loadTextures")
            self.below(3, slot)

    def mesh(self, n):
        self.call("makeMesh")
        self.number(0, 40, n)
        self.number(0, 40, n)
        self.below(2, 0)
        self.number(0, 64, 32)
        self.number(0, 64, 32)
        self.there("positions")
        self.there("indices")

    def ripple(self, n, x, y):
        self.call("ripple")
        for value in (32, 32, n, n):
            self.number(0, 64, value)
        for value in (x, y, 2.2):
            self.real(value)
        self.there("field")

    def move(self, n):
        self.call("moveWater")
        for most, value in ((4, 1), (4, 1), (40, n - 1), (40, n - 1), (48, n), (40, n)):
            self.number(0, most, value)
        self.below(2, 1)
        self.real(0.985)
        self.real(0.32)
        self.there("velocity")
        self.there("height")

    def touch(self, x, y, action, pressure=1.0):
        self.call("touch")
        self.number(-10, 245, x)
        self.number(-10, 245, y)
        self.number(0, 3, action)
        self.real(pressure)

    def draw(self, frames, n=4):
        self.call("draw")
        self.below(16, frames - 1)
        for count in (3 * n * n, 3 * n * n, 6 * (n - 1) * (n - 1)):
            self.number(0, 255, count)
        for value in (32, 32, n, n):
            self.number(0, 64, value)
        for value in (1.75, 0.5, 0.7, 1, 0.05, 0.15, 0.45, 0.8, 4.5, 40):
            self.real(value)
        self.below(2, 0)
        for array in ("positions", "heights", "indices", "mvp"):
            self.there(array)

    def ask(self):
        self.call("askForInk")

    def clear(self):
        self.call("clearInk")

    def save(self, name):
        directory = pathlib.Path(__file__).parent / "seeds" / "natives"
        directory.mkdir(parents=True, exist_ok=True)
        (directory / name).write_bytes(bytes(reversed(self.drawn)))


def started(width, height, ink):
    session = Session()
    session.pictures()
    session.set_up(width, height, ink)
    session.mesh(16)
    return session


def stroke(session, pixels_a_frame, pressure=1.0):
    x = 70
    session.touch(x, 80, DOWN, pressure)
    session.draw(1)
    for _ in range(10):
        x += pixels_a_frame
        session.touch(x, 80, MOVE, pressure)
        session.draw(2)
    session.touch(x, 80, UP, pressure)
    session.draw(4)


water = started(160, 240, False)
for x, y in ((0, 0), (10, -5), (-15.9, 15.9)):
    water.ripple(16, x, y)
    water.move(16)
    water.draw(1)
water.save("water")

tap = started(160, 240, True)
tap.touch(80, 120, DOWN)
tap.draw(14)
tap.touch(80, 120, UP)
tap.ask()
tap.draw(4)
tap.clear()
tap.touch(2, 120, DOWN)
tap.draw(3)
tap.touch(2, 120, CANCEL)
tap.draw(1)
tap.save("taps")

for name, pixels in (("slow", 1), ("medium", 6), ("fast", 15)):
    drag = started(240, 160, True)
    stroke(drag, pixels)
    drag.save(name + "_stroke")

renewed = started(150, 200, True)
stroke(renewed, 15)
renewed.set_up(200, 150, True)
stroke(renewed, 1)
renewed.set_up(200, 150, False)
renewed.draw(1)
renewed.set_up(8, 8, True)
renewed.touch(4, 4, DOWN)
renewed.draw(2)
renewed.save("renewed_set_up")

large = started(4096, 2160, True)
large.touch(240, 240, DOWN)
large.draw(3)
large.set_up(2**31 - 1, 2**31 - 1, True)
large.draw(1)
large.save("large_views")
