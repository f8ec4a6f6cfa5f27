# Writes a workbook with Perl's Excel::Writer::XLSX: write_excel_writer_xlsx.pl DATA_FOLDER
use strict;
use warnings;
use utf8;
use Excel::Writer::XLSX;

my $book = Excel::Writer::XLSX->new("$ARGV[0]/excel_writer_xlsx_chart.xlsx");
$book->set_properties(created => [gmtime 1704164645]);
my $chart = $book->add_chart(type => 'pie', name => 'First comes a chart');
my $sheet = $book->add_worksheet('Données');
my $empty = $book->add_worksheet('Vide');
my $last  = $book->add_worksheet('Fin');
$chart->add_series(values => "='Données'!\$B\$2:\$B\$6");

my $day  = $book->add_format(num_format => 'dd/mm/yy');
my $time = $book->add_format(num_format => 21);
my $bold = $book->add_format(bold => 1, num_format => '0.000');
$sheet->write_row(0, 0, ['jour', 'valeur', 'texte', 'somme', 'heure', 'vrai']);
for my $row (1 .. 5) {
    $sheet->write_date_time($row, 0, sprintf('20%02d-%02d-1%dT00:00:00', $row * 9, $row, $row),
        $day);
    $sheet->write_number($row, 1, $row**7 / 3, $bold);
    $sheet->write_string($row, 2, "été n° $row – " . ('ç' x ($row * 10)));
    $sheet->write_formula($row, 3, "=SUM(B2:B$row)", undef, $row * 1.25) unless $row == 3;
    $sheet->write_date_time($row, 4, sprintf('T%02d:%02d:00', $row * 4, $row), $time);
    $sheet->write_boolean($row, 5, $row % 2);
}
$sheet->set_column(1, 1, 10, undef, 1);
$sheet->merge_range(7, 0, 8, 2, 'fusion', $bold);
$last->write(2, 2, 'À la ligne 3');
$last->write(3, 2, 'suite');
$last->write(0, 0, 2024);
$last->write(1, 0, 1);
$book->close;
