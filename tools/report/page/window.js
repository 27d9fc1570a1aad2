// The charts, states and tables of a report. Everything on the page is there without this, drawn as lines; it adds zoom,
// reading by pointer and key, and sorting. The files of this folder run one after another in one function.
const page = document.documentElement;
page.classList.add('js');
const data = JSON.parse(document.getElementById('data').textContent);
const dark = matchMedia('(prefers-color-scheme: dark)');
const length = Math.max(data.length, 1);
const shortest = Math.min(length, data.axis === 'records' ? 5000 : 1000);
const longestLine = data.axis === 'records' ? Infinity : Math.max(30000, 3 * length / 1000);
const dashes = [null, [6, 3], [2, 3], [9, 3, 2, 3], [12, 4], [3, 2, 1, 2]];
const left = 52, right = 6;
const colour = name => getComputedStyle(page).getPropertyValue('--' + name).trim();
const make = (name, kind, parent) => {
    const element = document.createElement(name);
    element.className = kind;
    parent.append(element);
    return element;
};
const sums = differences => { let sum = 0; return differences.map(difference => sum += difference); };

// Times.
const drive = data.drives.reduce((one, other) => (other.stretches.length > one.stretches.length ? other : one));
function stretchAt(x) {
    const all = drive.stretches;
    let low = 0, high = all.length - 1;
    while (low < high) {
        const middle = (low + high + 1) >> 1;
        if (all[middle][0] <= x) low = middle; else high = middle - 1;
    }
    return all[low] || [0, 0];
}
const clockAt = x => { const [at, time] = stretchAt(x); return new Date(time + x - at); };
const two = number => String(Math.floor(number)).padStart(2, '0');
function elapsed(x, tenths) {
    const seconds = x / 1000;
    const text = (seconds >= 3600 ? Math.floor(seconds / 3600) + ':' : '') +
        (seconds >= 3600 ? two(seconds / 60 % 60) : Math.floor(seconds / 60)) + ':' + two(seconds % 60);
    return tenths ? text + '.' + Math.floor(x / 100 % 10) : text;
}
const recordAt = x => Math.round(x / 1000) + 1;
function valid(date) { return !Number.isNaN(date.getTime()); }
function whenText(x) {
    if (data.axis === 'records') return 'record ' + recordAt(x).toLocaleString('en');
    if (data.axis === 'elapsed') return elapsed(x, true) + ' from the start';
    const date = clockAt(x);
    return valid(date) ? date.toISOString().slice(0, 23).replace('T', ' ') + ' UTC' : elapsed(x, true);
}
const steps = [1, 2, 5, 10, 20, 50, 100, 200, 500, 1e3, 2e3, 5e3, 1e4, 15e3, 3e4, 6e4, 12e4, 3e5, 6e5, 9e5, 18e5, 36e5, 72e5,
    108e5, 216e5, 432e5, 864e5, 1728e5, 6048e5];
function ticks(from, to, width) {
    const step = steps.find(step => (to - from) / step <= Math.max(2, width / 78)) || (to - from) / 4;
    const label = x => {
        if (data.axis === 'records') return recordAt(x).toLocaleString('en');
        if (data.axis === 'elapsed') return elapsed(x, step < 1000);
        const date = clockAt(x);
        if (!valid(date)) return elapsed(x, false);
        return date.toISOString().slice(11, step < 1000 ? 23 : step < 60000 ? 19 : 16);
    };
    const found = [];
    const add = x => { if (!found.length || x - found[found.length - 1].v > step * 0.7) found.push({v: x, label: label(x)}); };
    const stretches = data.axis === 'clock' ? drive.stretches : [[0, 0]];
    for (let i = 0; i < stretches.length && found.length < 200; ++i) {
        const [at, time] = stretches[i];
        const end = Math.min(to, i + 1 < stretches.length ? stretches[i + 1][0] : to);
        const begin = Math.max(from, at);
        if (begin > end) continue;
        let x = begin + (step - (time + begin - at) % step) % step;
        for (; x <= end && found.length < 200; x += step) add(x);
    }
    return found;
}

// What is seen: one window and one place to read, of all charts.
let range = [0, length];
let place = null;
const views = [];
const readout = document.getElementById('readout');
function show(from, to) {
    const span = Math.min(length, Math.max(shortest, to - from));
    const start = Math.min(Math.max(0, from), length - span);
    range = [start, start + span];
    for (const view of views) view.draw();
    read(place);
}
const zoom = (factor, around) => show(around - (around - range[0]) * factor, around + (range[1] - around) * factor);
const middle = () => (place !== null && place >= range[0] && place <= range[1] ? place : (range[0] + range[1]) / 2);
const pan = share => show(range[0] + share * (range[1] - range[0]), range[1] + share * (range[1] - range[0]));
function read(x) {
    place = x === null ? null : Math.min(Math.max(x, 0), length);
    const parts = [];
    for (const view of views) view.read(place, parts);
    readout.textContent = '';
    if (place === null) {
        readout.textContent = range[0] > 0 || range[1] < length
            ? `${whenText(range[0])} to ${whenText(range[1])}`
            : 'Point, drag or use the arrow keys to read and zoom.';
        return;
    }
    const time = make('b', '', readout);
    time.textContent = whenText(place);
    readout.append(parts.length ? ' · ' + parts.join(' · ') : '');
}
function moveTo(x) {
    const at = Math.min(Math.max(x, 0), length);
    if (at < range[0] || at > range[1]) {
        const half = (range[1] - range[0]) / 2;
        place = at;
        show(at - half, at + half);
    } else {
        read(at);
    }
}
const changes = data.drives.flatMap(one => sums(one.marks.x)).sort((a, b) => a - b);
function keyed(event) {
    const span = range[1] - range[0];
    const x = place === null ? range[0] : place;
    const step = event.shiftKey ? span / 10 : span / 100;
    const keys = {
        ArrowLeft: () => moveTo(x - step), ArrowRight: () => moveTo(x + step),
        PageUp: () => pan(-0.5), PageDown: () => pan(0.5),
        Home: () => moveTo(0), End: () => moveTo(length),
        '+': () => zoom(0.5, middle()), '=': () => zoom(0.5, middle()), '-': () => zoom(2, middle()),
        '0': () => show(0, length), Escape: () => { place = null; show(0, length); },
        n: () => { const next = changes.find(at => at > x + 0.5); if (next !== undefined) moveTo(next); },
        p: () => { const before = changes.filter(at => at < x - 0.5).pop(); if (before !== undefined) moveTo(before); },
    };
    if (event.ctrlKey || event.altKey || event.metaKey || !keys[event.key]) return;
    event.preventDefault();
    keys[event.key]();
}

// Pointers: moving reads, dragging zooms (with Shift it shifts); fingers read, and two of them zoom.
function follow(plot, selection) {
    const xAt = event => {
        const box = plot.getBoundingClientRect();
        const share = (event.clientX - box.left - left) / Math.max(1, box.width - left - right);
        return range[0] + Math.min(1, Math.max(0, share)) * (range[1] - range[0]);
    };
    const pixel = x => left + (x - range[0]) / (range[1] - range[0]) * (plot.clientWidth - left - right);
    const fingers = new Map();
    let begun = null;
    plot.addEventListener('pointerdown', event => {
        if (event.pointerType === 'touch') fingers.set(event.pointerId, xAt(event));
        else if (event.button === 0) begun = {x: xAt(event), shift: event.shiftKey, range: [...range], clientX: event.clientX};
        if (begun) plot.setPointerCapture(event.pointerId);
        moveTo(xAt(event));
    });
    plot.addEventListener('pointermove', event => {
        if (fingers.size === 2 && fingers.has(event.pointerId)) {
            const [other] = [...fingers].find(([id]) => id !== event.pointerId);
            const still = fingers.get(other), moved = fingers.get(event.pointerId), now = xAt(event);
            if (Math.abs(now - still) > 1e-6 && (now - still) * (moved - still) > 0) zoom((moved - still) / (now - still), still);
            return;
        }
        if (begun && begun.shift) {
            const shift = (event.clientX - begun.clientX) / (plot.clientWidth - left - right) * (begun.range[1] - begun.range[0]);
            show(begun.range[0] - shift, begun.range[1] - shift);
            return;
        }
        const x = xAt(event);
        read(x);
        if (!begun) return;
        const from = pixel(Math.min(begun.x, x)), to = pixel(Math.max(begun.x, x));
        Object.assign(selection.style, {display: 'block', left: from + 'px', width: to - from + 'px'});
    });
    const end = event => {
        fingers.delete(event.pointerId);
        selection.style.display = 'none';
        if (begun && !begun.shift && event.type === 'pointerup' && Math.abs(event.clientX - begun.clientX) > 6) {
            const x = xAt(event);
            show(Math.min(begun.x, x), Math.max(begun.x, x));
        }
        begun = null;
    };
    plot.addEventListener('pointerup', end);
    plot.addEventListener('pointercancel', end);
    plot.addEventListener('pointerleave', event => { if (!begun && event.pointerType !== 'touch' && document.activeElement !== plot) read(null); });
    plot.addEventListener('dblclick', () => show(0, length));
    plot.addEventListener('wheel', event => {
        if (!event.ctrlKey) return;
        event.preventDefault();
        zoom(event.deltaY < 0 ? 0.8 : 1.25, xAt(event));
    }, {passive: false});
    plot.addEventListener('keydown', keyed);
    plot.addEventListener('focus', () => { if (place === null) read((range[0] + range[1]) / 2); });
    return pixel;
}
