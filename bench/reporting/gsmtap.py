"""A capture of radio messages as other tools make it: GSMTAP in UDP, LTE RRC (3GPP TS 36.331) and GSM Um (3GPP
TS 44.018) inside, of varied content."""

import random
import struct

from .bits import Bits
from .pcap import file_header, record_header

ETHERNET = 1  # link type
PORT = 4729  # of GSMTAP
UM, LTE_RRC = 0x01, 0x0D  # types of its payload
UL_DCCH, BCCH_BCH, BCCH_DL_SCH, PCCH = 3, 4, 5, 6  # channels of LTE RRC
UM_CCCH = 0x02


def measurement_report(choice):
    """What a handset reports of its cell and its neighbours."""
    bits = Bits().put(0, 1).put(1, 4)  # c1, measurementReport
    bits.put(0, 1).put(0, 3).put(0, 1)  # c1, r8, no extension
    bits.put(0, 1).put(1, 1)  # with neighbours
    bits.put(choice.randrange(32), 5).put(choice.randrange(98), 7).put(choice.randrange(35), 6)
    neighbours = choice.randint(3, 8)
    bits.put(0, 1).put(0, 2).put(neighbours - 1, 3)  # of E-UTRA
    for _ in range(neighbours):
        bits.put(0, 1).put(choice.randrange(504), 9)
        bits.put(0, 1).put(3, 2).put(choice.randrange(98), 7).put(choice.randrange(35), 6)
    return bits.bytes()


def paging(choice):
    records = choice.randint(1, 4)
    bits = Bits().put(0, 1).put(8, 4).put(records - 1, 4)  # c1, a list of records and nothing else
    for _ in range(records):
        bits.put(0, 2).put(0, 1)  # an S-TMSI
        bits.put(choice.randrange(256), 8).put(choice.getrandbits(32), 32).put(0, 1)
    return bits.bytes()


def master_information(choice):
    bits = Bits().put(choice.randrange(6), 3).put(choice.randrange(8), 3)
    return bits.put(choice.randrange(256), 8).put(0, 10).bytes()


def system_information(choice):
    """Block type 1."""
    bits = Bits().put(0, 1).put(1, 1).put(0, 3)  # c1, block 1, without what is optional
    bits.put(0, 1).put(0, 3).put(1, 1)  # one network, with its country
    for digit in (0, 0, 1):
        bits.put(digit, 4)
    bits.put(0, 1).put(0, 4).put(1, 4).put(0, 1)
    bits.put(choice.getrandbits(16), 16).put(choice.getrandbits(28), 28).put(1, 1).put(0, 1).put(0, 1)
    bits.put(0, 1).put(choice.randrange(49), 6)  # selection
    bits.put(choice.randrange(41), 6)  # band
    blocks = choice.randint(2, 5)
    bits.put(blocks - 1, 5)
    for block in range(blocks):
        bits.put(choice.randrange(7), 3).put(1, 5).put(0, 1).put(block, 4)
    return bits.put(choice.randrange(7), 3).put(choice.randrange(32), 5).bytes()


def paging_request(choice):
    """GSM, type 1: two mobiles, padded to the length of a block."""
    identities = b"".join(b"\x05\xf4" + struct.pack(">I", choice.getrandbits(32)) for _ in range(2))
    identities = identities[:6] + b"\x17" + identities[6:]
    message = b"\x06\x21\x20" + identities
    return (bytes([len(message) << 2 | 1]) + message).ljust(23, b"\x2b")


KINDS = [(5, LTE_RRC, UL_DCCH, measurement_report), (3, LTE_RRC, PCCH, paging),
         (1, LTE_RRC, BCCH_BCH, master_information), (2, LTE_RRC, BCCH_DL_SCH, system_information),
         (1, UM, UM_CCCH, paging_request)]  # how often, what, and who writes it


def checksum(header):
    total = sum(struct.unpack(f">{len(header) // 2}H", header))
    while total >> 16:
        total = (total & 0xFFFF) + (total >> 16)
    return ~total & 0xFFFF


def in_udp(payload, number):
    udp = struct.pack(">HHHH", 40000, PORT, 8 + len(payload), 0) + payload  # 0: no checksum
    fields = [0x45, 0, 20 + len(udp), number & 0xFFFF, 0x4000, 64, 17, 0, b"\x7f\0\0\1", b"\x7f\0\0\1"]
    fields[7] = checksum(struct.pack(">BBHHHBBH4s4s", *fields))
    return bytes(12) + b"\x08\0" + struct.pack(">BBHHHBBH4s4s", *fields) + udp


def write_capture(path, packets, seed=1):
    """Some 24,000 different messages in turn, each in a packet with header values of its own."""
    choice = random.Random(seed)
    kinds = choice.choices(KINDS, [kind[0] for kind in KINDS], k=24_000)
    pool = [(kind, channel, make(choice)) for _, kind, channel, make in kinds]
    with open(path, "wb", buffering=1 << 20) as file:
        file.write(file_header(ETHERNET))
        for number in range(packets):
            kind, channel, content = pool[number % len(pool)]
            header = struct.pack(">BBBBHbbIBBBB", 2, 4, kind, 0, number * 7 % 1024, -50 - number % 60,
                                 number % 30, number % 2715648, channel, 0, 0, 0)
            packet = in_udp(header + content, number)
            file.write(record_header(number / 300, len(packet)) + packet)
