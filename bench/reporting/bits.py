"""Bits one behind the other, the most significant first, as unaligned PER has them."""


class Bits:
    def __init__(self):
        self.value = 0
        self.length = 0

    def put(self, value, width):
        self.value = self.value << width | value & (1 << width) - 1
        self.length += width
        return self

    def bytes(self):
        """Filled up with 0 bits."""
        spare = -self.length % 8
        return (self.value << spare).to_bytes((self.length + spare) // 8, "big")
