"""What must be shown: for each kind of row a formula, its bound, and the sentence that the table prints."""
import dataclasses
import re

from figures import (AddedGrowth, AddedRatio, Counter, InstructionRatio, Instructions, PerEntryGrowth, Ratio)


@dataclasses.dataclass
class Rule:
    rows: str  # a regular expression for whole names of rows
    figure: object
    bound: float  # the largest figure that meets it
    text: str

    def applies(self, row):
        return re.fullmatch(self.rows, row) is not None


PER_PLUGIN = PerEntryGrowth('ours', 'plugins', 10000, 1000)

RULES = [
    Rule(r'P1/.*', AddedRatio('ours', over='peer'), 0.5, 'added cost, over the peer\'s'),
    Rule(r'P1/.*', Instructions('ours'), 400, 'instructions added to a block'),
    Rule(r'P2/(.*/)?parameters:4096(/.*)?', AddedGrowth('ours', 'parameters:4096', 'parameters:4'), 1.1,
         'added cost at 4096 parameters, over that at 4'),
    Rule(r'P3/.*', AddedRatio('ours', over='peer'), 0.5, 'added cost of parameter changes, over the peer\'s'),

    Rule(r'P4/load/plugins:8000', Ratio('ours', over=('peer',)), 0.05, 'time, over the peer\'s'),
    Rule(r'P4/(load|save|add|add-known)/plugins:10000', PER_PLUGIN, 1.3,
         'time per plug-in at 10000, over that at 1000'),
    Rule(r'P4/find-(id|locator)/plugins:10000', PER_PLUGIN, 1.3,
         'time per look-up, in the order of the catalogue, at 10000, over that at 1000'),
    Rule(r'P4/find-(id|locator)-anywhere/plugins:10000', PER_PLUGIN, 1.3,
         'time per look-up, in an order without a pattern, at 10000, over that at 1000'),

    Rule(r'P5/first/in-process', Ratio('ours', over=('peer',)), 1.1, 'time, over the peer\'s'),
    Rule(r'P5/first/worker', Ratio('ours', over=('peer',)), 1.6, 'time, over the peer\'s in process'),
    Rule(r'P5/again/.*', Counter('opened', 'ours'), 0, 'plug-in binaries opened'),

    Rule(r'P6/.*', Ratio('ours', over=('spsc', 'other')), 1.1,
         'time, over the best other ring\'s'),

    Rule(r'P7/(save|load)/bytes:10000', Ratio('ours', over=('peer',)), 0.2,
         'time, text written or read included, over the peer\'s'),
    Rule(r'P7/.*/bytes:10000000', Counter('peak', 'ours'), 3.0, 'peak memory, in chunks'),
    Rule(r'P7/.*', Counter('differing', 'ours'), 0, 'bytes that differ'),

    Rule(r'P8/tail(/.*)?', Ratio('ours', over=('direct',)), 1.2, 'time of a block in the tail, over a normal one\'s'),
    Rule(r'P8/mode(/.*)?', Counter('changed', 'ours'), 0, 'blocks that changed the floating-point mode'),

    Rule(r'P9/identity(/.*)?', InstructionRatio('ours', over='nomap'), 1.01, 'instructions, over those without a map'),
    Rule(r'P9/bypass/.*latency:0', Ratio('ours', over=('copy',)), 1.2, 'time, over a plain copy\'s'),
    Rule(r'P9/bypass/.*latency:[1-9]\d*', Ratio('ours', over=('copy',)), 1.2,
         'time, over that of two copies, into a store and out of it'),
]
