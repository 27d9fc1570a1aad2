// Tables that sort.
function addSorting(table) {
    const body = table.tBodies[0];
    const headings = [...table.tHead.rows[0].cells];
    headings.forEach((heading, column) => {
        const button = document.createElement('button');
        button.type = 'button';
        button.append(...heading.childNodes);
        heading.append(button);
        heading.setAttribute('aria-sort', 'none');
        button.addEventListener('click', () => {
            const isNumber = heading.classList.contains('n');
            const before = heading.getAttribute('aria-sort');
            const down = before === 'none' ? isNumber : before === 'ascending';
            for (const other of headings) other.setAttribute('aria-sort', 'none');
            heading.setAttribute('aria-sort', down ? 'descending' : 'ascending');
            const order = new Intl.Collator('en', {numeric: true}).compare;
            const rows = [...body.rows].map(row => {
                const cell = row.cells[column], key = cell.dataset.k;
                return {row, key: key === undefined ? cell.textContent : Number(key), none: key === undefined && cell.textContent === '–'};
            });
            rows.sort((one, other) => {
                if (one.none || other.none) return one.none - other.none;
                const both = typeof one.key === 'number' && typeof other.key === 'number';
                const difference = both ? one.key - other.key : order(String(one.key), String(other.key));
                return down ? -difference : difference;
            });
            body.append(...rows.map(({row}) => row));
        });
    });
}

const figures = [...document.querySelectorAll('figure.chart')];
data.charts.forEach((chart, i) => {
    chart.measure = chart.title.includes(': ') ? chart.title.replace(/^[^:]*: /, '') + ' ' : '';
    addChart(chart, figures[i]);
});
const laneFigures = [...document.querySelectorAll('figure.states')];
let laneFigure = 0;
for (const one of data.drives) if (one.lanes.length) addLanes(one, laneFigures[laneFigure++]);
const actions = {in: () => zoom(0.5, middle()), out: () => zoom(2, middle()), earlier: () => pan(-0.5), later: () => pan(0.5), all: () => show(0, length)};
for (const button of document.querySelectorAll('.tools button')) button.addEventListener('click', actions[button.dataset.do]);
for (const table of document.querySelectorAll('table.sortable')) addSorting(table);
addEventListener('resize', () => read(place));
dark.addEventListener('change', () => { for (const view of views) view.theme(); });
if (readout) read(null);
page.dataset.ready = Math.round(performance.now());
