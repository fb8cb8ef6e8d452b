"""The chart of the whole runs: seconds against hot folders, both axes logarithmic."""
import math

WIDTH, HEIGHT = 760, 440
LEFT, RIGHT, TOP, BOTTOM = 70, 600, 40, 380
SERIES = (('logged', 'tool, log on', '#b5432a'), ('tool', 'tool, log off', '#1f5fa8'), ('floor', 'floor', '#6d6d6d'),
          ('script', 'script', '#3c8a4e'), ('old', 'b6c3480, log off', '#d99a2b'))


def text(x, y, content, extra=''):
    return f'<text x="{x:.0f}" y="{y:.0f}" {extra}>{content}</text>'


def draw(results):
    times = [now[name] for now in results for name, _, _ in SERIES if name in now]
    low, high = math.floor(math.log10(min(times))), math.ceil(math.log10(max(times)))
    first, last = (math.log10(results[i]['count']) for i in (0, -1))

    def at(count, seconds):
        return (LEFT + (RIGHT - LEFT) * (math.log10(count) - first) / max(last - first, 1),
                BOTTOM - (BOTTOM - TOP) * (math.log10(seconds) - low) / (high - low))

    parts = [f'<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 {WIDTH} {HEIGHT}" '
             'font-family="sans-serif" font-size="13" fill="#222222">',
             f'<rect width="{WIDTH}" height="{HEIGHT}" fill="#ffffff"/>',
             text(LEFT, TOP - 14, 'A whole run on a tmpfs, both axes logarithmic'),
             text((LEFT + RIGHT) / 2, BOTTOM + 36, 'hot folders', 'text-anchor="middle"')]
    for decade in range(low, high + 1):
        y = at(results[0]['count'], 10 ** decade)[1]
        parts += [f'<path d="M{LEFT} {y:.0f}H{RIGHT}" stroke="#dddddd"/>',
                  text(LEFT - 8, y + 4, f'{10 ** decade:g} s', 'text-anchor="end"')]
    for now in results:
        x = at(now['count'], 1)[0]
        parts += [f'<path d="M{x:.0f} {TOP}V{BOTTOM}" stroke="#dddddd"/>',
                  text(x, BOTTOM + 18, f"{now['count']:,}", 'text-anchor="middle"')]
    labels = []
    for name, label, colour in SERIES:
        points = [at(now['count'], now[name]) for now in results if name in now]
        if points:
            line = ' '.join(f'{x:.1f},{y:.1f}' for x, y in points)
            parts.append(f'<polyline fill="none" stroke-width="2" stroke="{colour}" points="{line}"/>')
            x, y = points[-1]
            if x < RIGHT:
                parts.append(text(x, y - 8, label, f'fill="{colour}" text-anchor="middle"'))
            else:
                labels.append([y + 4, x + 10, label, colour])
    labels.sort()
    for above, below in zip(labels, labels[1:]):
        below[0] = max(below[0], above[0] + 15)
    parts += [text(x, y, label, f'fill="{colour}"') for y, x, label, colour in labels]
    return '\n'.join(parts) + '\n</svg>\n'
